#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

// How the program meets the system that started it.
namespace kickvane::platform {

// The program's arguments (without its own name) in UTF-8. On Windows they are read from the
// UTF-16 command line, since `argv` holds them in the ANSI code page, which loses letters such as
// Vietnamese ones; elsewhere `argv` is UTF-8 already.
std::vector<std::string> ProgramArguments(int argc, char** argv);

// Makes standard output and error reach the console that the program was started from (a
// windowed program joins its parent's console), so that subcommands print there as a console
// program would. Text bound for a console is written as UTF-16 through the console's own
// functions, so Vietnamese shows whatever the console's code page; redirected output gets UTF-8
// bytes as they are (no line-end translation). Nothing to do outside Windows.
void UseParentConsole();

// True where the game, a Windows program, runs under Wine (in a prefix) rather than natively.
bool GameRunsUnderWine();

// The length of the longest start of `utf8` that does not end inside a multi-byte sequence: what
// can be converted now when the rest of the text is still to come. Bytes that can begin no
// sequence count as complete.
inline std::size_t CompleteUtf8Length(std::string_view utf8) {
    const std::size_t size = utf8.size();
    // A cut sequence begins at most three bytes before the end.
    for (std::size_t back = 1; back <= 3 && back <= size; ++back) {
        const auto byte = static_cast<unsigned char>(utf8[size - back]);
        if ((byte & 0xC0) == 0x80) {
            continue;  // a continuation byte: look further back for the lead
        }
        const std::size_t needed = byte >= 0xF0 ? 4 : byte >= 0xE0 ? 3 : byte >= 0xC0 ? 2 : 1;
        return needed > back && byte < 0xF8 ? size - back : size;
    }
    return size;
}

}  // namespace kickvane::platform
