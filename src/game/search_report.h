#pragma once

#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <system_error>

// What the game search reports, as values: the managers by name, where a found folder came from,
// and why a file was passed over. The words for people are made from them at the edge.
namespace kickvane::game {

enum class Manager { Wine, Lutris, Bottles, Heroic, PlayOnLinux, Steam, WineMenu };

constexpr std::string_view ManagerName(Manager manager) {
    switch (manager) {
        case Manager::Wine:
            return "Wine";
        case Manager::Lutris:
            return "Lutris";
        case Manager::Bottles:
            return "Bottles";
        case Manager::Heroic:
            return "Heroic";
        case Manager::PlayOnLinux:
            return "PlayOnLinux";
        case Manager::Steam:
            return "Steam";
        case Manager::WineMenu:
            break;
    }
    return "Wine menu";
}

// How a folder that holds the launcher came to be known. On Linux the manager's entry that named
// the prefix (or the program) comes first, then where in the prefix it was.
struct GameSource {
    enum class Kind {
        ManagerProgram,  // the folder of the program a manager's entry starts
        RegistryEntry,   // an uninstall entry of the registry (`place`: its key, `value`: the
                         // value's name; on Linux `registryFile` is system.reg or user.reg)
        PrefixSearch,    // Linux: the search of the prefix's drive_c
        Shortcut,        // Windows: a shortcut whose target is the launcher (`place`: its path)
        Drive,           // Windows: the search of a fixed drive (`place`: its root, "D:\")
    };
    Kind kind = Kind::PrefixSearch;
    // Linux: the manager's entry.
    Manager manager = Manager::Wine;
    bool flatpak = false;
    std::string name;        // the name the manager shows; empty when none
    std::string configFile;  // where the entry was read, "~/..." below the home folder
    // Where in it.
    std::string place;
    std::string value;
    std::string registryFile;
};

// Why a file (or a folder's search) was passed over by the game search.
enum class SkipReason {
    Missing,      // the file is not there
    NotAFile,     // a folder, device or pipe
    TooLarge,     // over `number` bytes
    Unreadable,   // the system's `error`
    NotText,      // not a text file
    Malformed,    // its format's reader refused it; `number` is the line when known (else 0)
    TooComplex,   // nested too deep or too many values
    NotRegistry,  // not a Wine registry file
    SearchCut,    // the search of a folder reached its limits after `number` entries
};

struct SkippedFile {
    std::filesystem::path path;
    SkipReason reason = SkipReason::Malformed;
    std::uintmax_t number = 0;
    std::error_code error;
    std::string detail;  // Malformed: the reader's own words (English), for logs and tests
};

}  // namespace kickvane::game
