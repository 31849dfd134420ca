#pragma once

#include <string>
#include <vector>

// How the program meets the system that started it.
namespace kickvane::platform {

// The program's arguments (without its own name) in UTF-8. On Windows they are read from the
// UTF-16 command line, since `argv` holds them in the ANSI code page, which loses letters such as
// Vietnamese ones; elsewhere `argv` is UTF-8 already.
std::vector<std::string> ProgramArguments(int argc, char** argv);

// Makes standard output and error reach the console that a windowed program was started from,
// writing UTF-8 bytes as they are (no line-end translation), so that subcommands print there as a
// console program would. Output that the caller redirected stays where it goes. Nothing to do
// outside Windows.
void UseParentConsole();

// True where the game, a Windows program, runs under Wine (in a prefix) rather than natively.
bool GameRunsUnderWine();

}  // namespace kickvane::platform
