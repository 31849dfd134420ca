# Lays out the demo tool folder (base set and variants, a few small stand-in files each) and a
# demo game folder shaped like the game's install folder. Run with
#   cmake -DTOOL_DIR=... -DGAME_DIR=... -P make_demo.cmake
# The files only stand in for the real graphics: each holds a line saying what it is.

function(stand_in folder)
  foreach(name IN LISTS ARGN)
    file(WRITE "${folder}/${name}" "Kickvane demo file: ${folder}/${name}\n")
  endforeach()
endfunction()

set(base "${TOOL_DIR}/data/data2")
set(zbase "${TOOL_DIR}/data/zdata/data2")
set(extras "${TOOL_DIR}/extras")

# Base set, laid out like the game's data2 tree.
stand_in("${base}/ball" ball_main.ea3.em)
stand_in("${base}/pitch/textures" grass.dds grass_dirt.dds grass_pitchlines.dds)
stand_in("${base}/adboard" adboard_main.dds)
stand_in("${base}/ingame_ad" ingame_ad_01.dds)
foreach(hud chatting DistanceToNet PK radar RefAdvantage watermark)
  stand_in("${base}/gui/hud/${hud}" ${hud}.dds)
endforeach()
stand_in("${base}/gui/loading" loading_01.dds loading_02.dds)
# No "gui/font" in the base set: the interface category skips it.
stand_in("${base}/gui/hud/scoreboard" scoreboard.dds)
stand_in("${base}/gui/hud/namebar" namebar.dds)
stand_in("${base}/gui/hud/Indicator" indicator.dds)
stand_in("${base}/teams/emblems" emblem_001.dds emblem_002.dds)
stand_in("${base}/cmn" cmn_settings.dds)
stand_in("${base}/players/bodies/textures" skin_01.dds)
stand_in("${base}/players/heads/textures" face_001.dds cm_001.dds)
stand_in("${base}/players/heads" hhead_001.pc.ea3.em)
stand_in("${base}/players/accessories" boots_01.dds)
stand_in("${base}/players/kit" kit_home.dds kit_away.dds)
stand_in("${base}/net/textures" net.dds)

# Base set of the second tree.
stand_in("${zbase}/ball" ball10_01.ea3.em)
stand_in("${zbase}/ball/textures" ball10.dds)
stand_in("${zbase}/pitch" pitch_model.ea3.em)
stand_in("${zbase}/crowd/textures" crowd_01.dds)
stand_in("${zbase}/stadiums" stadium_01.ea3.em)

# Variants.
foreach(set "Europa League 2011" "Teamgeist Blue White" "UCL 2011")
  stand_in("${extras}/Ball/${set}" ball10_01.ea3.em)
  stand_in("${extras}/Ball/${set}/textures" ball10.dds)
endforeach()
foreach(set "Caro" "Oval UCL" "Caro UCL")
  stand_in("${extras}/pitch/${set}" grass.dds grass_dirt.dds)
endforeach()
stand_in("${extras}/pitch/_textures" grass_shadow.dds)
foreach(set "UCL" "Viet Nam" "WC 2010")
  stand_in("${extras}/adboard/${set}" adboard_main.dds)
endforeach()
foreach(set "SkySport Blue" "ESPN HD" "StarSports Blue" "K+ NS" "VTC HD VIP" "VTV3 UCL"
            "SupaStrikas UCL Red")
  stand_in("${extras}/scoreboard/${set}/scoreboard" scoreboard.dds)
  stand_in("${extras}/scoreboard/${set}/namebar" namebar.dds)
endforeach()
foreach(set "Mat cuoi" "PES vang")
  stand_in("${extras}/Indicator/${set}" indicator.dds)
endforeach()

# One set per group that a player would add: not in the catalog, found by listing the folders.
stand_in("${extras}/Ball/Bóng Tết 2026" ball10_01.ea3.em)
stand_in("${extras}/Ball/Bóng Tết 2026/textures" ball10.dds)
stand_in("${extras}/scoreboard/Đài Truyền hình/scoreboard" scoreboard.dds)
stand_in("${extras}/scoreboard/Đài Truyền hình/namebar" namebar.dds)
stand_in("${extras}/adboard/V-League 2026" adboard_main.dds)
stand_in("${extras}/pitch/Sọc ngang" grass.dds)
stand_in("${extras}/Indicator/Mũi tên đỏ" indicator.dds)

# The demo game: both data trees, some folders spelled in another letter case as Windows games
# often have them, and a launcher that only says it ran.
if(NOT EXISTS "${GAME_DIR}/data2")
  stand_in("${GAME_DIR}/data2/Ball" ball_main.ea3.em)
  stand_in("${GAME_DIR}/data2/Pitch/Textures" grass.dds)
  stand_in("${GAME_DIR}/data2/teams" teams.dat)
  stand_in("${GAME_DIR}/zdata/data2/ball" ball10_01.ea3.em)
  stand_in("${GAME_DIR}/data2/GUI/hud" hud.dat)
  stand_in("${GAME_DIR}/data2/players" players.dat)
endif()
file(WRITE "${GAME_DIR}/Gameloader.exe" "#!/bin/sh\necho \"demo game launcher started in $(pwd)\"\n")
file(CHMOD "${GAME_DIR}/Gameloader.exe" PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE
     GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)

# The demo's settings point at the demo game; a settings file the user saved is kept.
if(NOT EXISTS "${TOOL_DIR}/ThietLap.ini")
  file(WRITE "${TOOL_DIR}/ThietLap.ini" "[Thiet lap]\r\nDuongDan=${GAME_DIR}\r\nPhimTat=F7\r\n")
endif()
