#pragma once

#include <string>
#include <string_view>
#include <vector>

// The parts of the game search on Windows that need no system call: reading the folder out of a
// registry value, and which folders of a drive are searched first.
namespace kickvane::game {

// The folder of the program that a registry value names: a path in quotes, a path followed by an
// icon index (",0"), or a command line whose program is an ".exe" followed by arguments. Empty
// when the value names no folder.
std::string FolderOfProgramValue(std::string_view value);

// Whether a folder at the top of a drive is searched, and how early. Program Files and folders
// named like "Games" come first (rank 0), the rest of the top folders after them (rank 1);
// Windows itself and the system's hidden bookkeeping ("$Recycle.Bin", "System Volume
// Information") are skipped (rank -1).
int DriveFolderRank(std::string_view name);

// Orders the top folders of a drive by rank, keeping their order within a rank, without the
// skipped ones.
std::vector<std::string> OrderDriveFolders(std::vector<std::string> names);

}  // namespace kickvane::game
