#pragma once

#include <gtest/gtest.h>

#include <string>

#include "support/temp_dir.h"

namespace kickvane::testing {

// A tool folder with one small file in every folder that the plan copies from.
inline void MakeToolFolder(const fs::path& tool) {
    const fs::path base = tool / "data/data2";
    for (const char* folder : {"ball", "adboard", "ingame_ad", "gui/loading", "teams/emblems",
                               "cmn", "players/bodies/textures", "players/heads/textures",
                               "players/accessories", "players/kit", "net/textures"}) {
        WriteFile(base / folder / "base.dds", std::string("base ") + folder);
    }
    for (const char* hud : {"chatting", "DistanceToNet", "PK", "radar", "RefAdvantage", "watermark",
                            "scoreboard", "namebar", "Indicator"}) {
        WriteFile(base / "gui/hud" / hud / "base.dds", std::string("base gui/hud/") + hud);
    }
    WriteFile(base / "pitch/textures/grass_dirt.dds", "base dirt");
    WriteFile(base / "pitch/textures/grass_pitchlines.dds", "base lines");
    const fs::path zbase = tool / "data/zdata/data2";
    for (const char* folder : {"ball/textures", "pitch", "crowd/textures", "stadiums"}) {
        WriteFile(zbase / folder / "zbase.dds", std::string("zbase ") + folder);
    }
    const fs::path extras = tool / "extras";
    WriteFile(extras / "Ball/UCL 2011/ball10.dds", "ucl ball");
    WriteFile(extras / "Ball/Europa League 2011/ball10.dds", "europa ball");
    WriteFile(extras / "pitch/Caro/grass.dds", "caro grass");
    WriteFile(extras / "pitch/Caro/grass_dirt.dds", "caro dirt");
    WriteFile(extras / "pitch/_textures/shadow.dds", "shared shadow");
    WriteFile(extras / "adboard/WC 2010/board.dds", "wc board");
    WriteFile(tool / "sound.wav", "RIFF");
}

// A game folder with its two data trees and the top folders a real install has.
inline void MakeGameFolder(const fs::path& game, bool withZData = true) {
    for (const char* folder : {"data2/gui/hud", "data2/players", "data2/pitch/textures"}) {
        fs::create_directories(game / folder);
    }
    if (withZData) {
        fs::create_directories(game / "zdata/data2");
    }
}

// A test with a temporary tool folder and game folder laid out as above.
class ToolAndGameTest : public ::testing::Test {
protected:
    void SetUp() override {
        MakeToolFolder(tool());
        MakeGameFolder(game());
    }

    fs::path tool() const { return dir_ / "tool"; }
    fs::path game() const { return dir_ / "game"; }

    // Settings that name the game folder and the hotkey.
    void WriteSettings(const std::string& hotkey) const {
        WriteFile(tool() / "ThietLap.ini",
                  "[Thiet lap]\r\nDuongDan=" + game().string() + "\r\nPhimTat=" + hotkey + "\r\n");
    }

    TempDir dir_;
};

}  // namespace kickvane::testing
