#pragma once

#include <string>

#include "game/launch_plan.h"
#include "game/search_report.h"
#include "platform/process.h"
#include "text/failure_text.h"

// The words a player reads about where the game was found and how it was started. The game
// module gives values; they are worded here, once, for the window and the command line alike.
namespace kickvane::session {

// The program that starts the launcher, by the name a player knows: "Gameloader.exe" when it
// runs by itself, else "Lutris", "Bottles", "Wine" or "Wine của Lutris".
std::string StarterName(const game::LaunchPlan& plan);

// Which way the launcher is started: "trực tiếp", "qua Lutris: FIFA Online 2 (số 42)",
// "qua Wine trong thư mục Wine /home/an/.wine (win64)".
std::string LaunchWayText(const game::LaunchPlan& plan);

// Why a start failed, naming the program that failed: "Không khởi động được FIFA: Wine dừng
// ngay với mã lỗi 3." A program that could not be run is worded by the failure table.
std::string LaunchFailureText(const game::LaunchPlan& plan, const platform::ProgramState& state,
                              const text::ShownFolders& folders);

// How a found folder came to be known: "Lutris: FIFA Online 2 (~/.config/lutris/games/fifa.yml),
// tìm trong drive_c", "lối tắt: C:\Users\An\Desktop\FIFA.lnk". Managers keep their names.
std::string SourceText(const game::GameSource& source);

// Why a file was passed over: "quá lớn (trên 4 MiB)", "sai định dạng ở dòng 3". A system error
// is worded by the failure table.
std::string SkippedReasonText(const game::SkippedFile& skipped);

}  // namespace kickvane::session
