#include <gtest/gtest.h>

#include <algorithm>

#include "game/formats/desktop_entry.h"
#include "game/formats/json.h"
#include "game/formats/vdf.h"
#include "game/formats/wine_registry.h"
#include "game/formats/yaml.h"

namespace kickvane::game {
namespace {

TEST(ParseYaml, ReadsLutrisAndBottlesShapes_WithQuotesListsCommentsAndBlockText_RefusesBinary) {
    const Parsed parsed = ParseYaml(
        "game:\n"
        "  exe: /home/u/Games/fifa/drive_c/FIFA Online 2/Gameloader.exe  # the launcher\n"
        "  prefix: '/home/u/Games/it''s here'\n"
        "  args: \"-a \\\"b\\\" \\u00e9\"\n"
        "script: |\n"
        "  not: a key\n"
        "  - nor an item\n"
        "External_Programs:\n"
        "  6f0c:\n"
        "    path: /b/Gameloader.exe\n"
        "items:\n"
        "- one\n"
        "- name: two\n"
        "url: http://x/#no-comment\n");
    ASSERT_TRUE(parsed.ok()) << parsed.problem;
    const FlatValues& v = parsed.values;
    EXPECT_EQ(v.Find("game.exe"), "/home/u/Games/fifa/drive_c/FIFA Online 2/Gameloader.exe");
    EXPECT_EQ(v.Find("game.prefix"), "/home/u/Games/it's here");
    EXPECT_EQ(v.Find("game.args"), "-a \"b\" \xC3\xA9");
    EXPECT_EQ(v.Find("External_Programs.6f0c.path"), "/b/Gameloader.exe");
    EXPECT_EQ(v.Find("items.0"), "one");
    EXPECT_EQ(v.Find("items.1.name"), "two");
    EXPECT_EQ(v.Find("url"), "http://x/#no-comment");
    EXPECT_EQ(v.Find("script"), "not: a key\n- nor an item\n");
    EXPECT_FALSE(v.Find("script.not"));
    EXPECT_FALSE(v.Find("not"));

    // Binary or keyless text is malformed, and so is a tree that aliases repeat without end.
    EXPECT_FALSE(ParseYaml(std::string("game:\n  exe: a\0b\n", 16)).ok());
    EXPECT_FALSE(ParseYaml("just some words\nand more\n").ok());
    EXPECT_FALSE(ParseYaml("game: [unclosed\n").ok());
    std::string bomb = "a: &a [x, x, x, x, x, x, x, x, x, x]\n";
    for (char name = 'b'; name <= 'h'; ++name) {
        const char previous = static_cast<char>(name - 1);
        bomb += std::string(1, name) + ": &" + name + " [*" + previous + ", *" + previous + ", *" +
                previous + ", *" + previous + ", *" + previous + ", *" + previous + ", *" +
                previous + ", *" + previous + ", *" + previous + ", *" + previous + "]\n";
    }
    const Parsed aliases = ParseYaml(bomb);
    EXPECT_FALSE(aliases.ok());
    EXPECT_EQ(aliases.values.size(), 0u);
    EXPECT_TRUE(ParseYaml("").ok());
}

// PyYAML, which Lutris and Bottles write with, folds a long plain scalar onto an indented second
// line, and a double-quoted one with a backslash at the break, writing letters outside ASCII as
// escapes.
TEST(ParseYaml, ReadsValuesFoldedOverLines_AndEscapedVietnameseLetters) {
    const Parsed parsed = ParseYaml(
        "game:\n"
        "  exe: /home/u/Games/fifa-online-2/drive_c/Program Files (x86)/Nexon/FIFA Online\n"
        "    2/Gameloader.exe\n"
        "  prefix: /home/u/Games/fifa-online-2\n"
        "External_Programs:\n"
        "  0c3b5e7a-91f2-4bd0-a0a5-6f2f3c1d2e4b:\n"
        "    path: \"/home/u/Tr\\xF2 ch\\u01A1i/B\\xF3ng \\u0111\\xE1/FIFA Online "
        "2/Gameloader.exe\\\n"
        "      \\ b\\u1EA3n m\\u1EDBi\"\n");
    ASSERT_TRUE(parsed.ok()) << parsed.problem;
    EXPECT_EQ(parsed.values.Find("game.exe"),
              "/home/u/Games/fifa-online-2/drive_c/Program Files (x86)/Nexon/FIFA Online "
              "2/Gameloader.exe");
    EXPECT_EQ(parsed.values.Find("External_Programs.0c3b5e7a-91f2-4bd0-a0a5-6f2f3c1d2e4b.path"),
              "/home/u/Tr\xC3\xB2 ch\xC6\xA1i/B\xC3\xB3ng \xC4\x91\xC3\xA1/FIFA Online "
              "2/Gameloader.exe b\xE1\xBA\xA3n m\xE1\xBB\x9Bi");
}

TEST(ParseJson, FlattensNestedValues_DecodesEscapes_AndRejectsBrokenOrTooDeepText) {
    const Parsed parsed = ParseJson(
        R"({"fifa": {"winePrefix": "/p/x", "wineVersion": {"bin": "/w/bin/wine", "type": "wine"},
            "n": 12.5e1, "on": true, "off": false, "none": null},
            "games": [{"app_name": "a\u00e9\ud83d\ude00", "t": "q\"\\/"}, []]})");
    ASSERT_TRUE(parsed.ok()) << parsed.problem;
    EXPECT_EQ(parsed.values.Find("fifa.winePrefix"), "/p/x");
    EXPECT_EQ(parsed.values.Find("fifa.wineVersion.bin"), "/w/bin/wine");
    EXPECT_EQ(parsed.values.Find("fifa.on"), "true");
    EXPECT_FALSE(parsed.values.Find("fifa.none"));
    EXPECT_EQ(parsed.values.Find("games.0.app_name"), "a\xC3\xA9\xF0\x9F\x98\x80");
    EXPECT_EQ(parsed.values.Find("games.0.t"), "q\"\\/");

    for (const std::string& broken :
         {std::string("{\"a\": \"unterminated}"), std::string("[1, 2"), std::string("{} trailing"),
          std::string("{\"a\": \"\\u12\"}"), std::string(100, '[') + std::string(100, ']')}) {
        EXPECT_FALSE(ParseJson(broken).ok()) << broken;
    }
}

TEST(ParseVdf, ReadsLibraryPaths_AndRejectsUnbalancedText) {
    const Parsed parsed = ParseVdf(
        "\"libraryfolders\"\n{\n  \"0\"\n  {\n    \"path\"\t\t\"/home/u/.local/share/Steam\"\n"
        "    \"apps\" { \"228980\" \"123\" }\n  }\n  // comment\n  \"1\" { \"path\" "
        "\"/mnt/g\\\\s\" }\n}\n");
    ASSERT_TRUE(parsed.ok()) << parsed.problem;
    EXPECT_EQ(parsed.values.Find("libraryfolders.0.path"), "/home/u/.local/share/Steam");
    EXPECT_EQ(parsed.values.Find("libraryfolders.0.apps.228980"), "123");
    EXPECT_EQ(parsed.values.Find("libraryfolders.1.path"), "/mnt/g\\s");
    EXPECT_FALSE(ParseVdf("\"a\" { \"b\" \"c\"").ok());
    EXPECT_FALSE(ParseVdf("\"a\" } ").ok());
    EXPECT_FALSE(ParseVdf("junk").ok());
}

TEST(ParseWineRegistry, ReadsWantedKeysOnly_WithEscapesContinuationsAndArch) {
    const std::string text =
        "WINE REGISTRY Version 2\n"
        ";; All keys relative to \\\\Machine\n"
        "#arch=win32\n"
        "\n"
        "[Software\\\\Microsoft\\\\Windows\\\\CurrentVersion\\\\Uninstall\\\\FIFA Online 2] "
        "1700000000\n"
        "#time=1d9\n"
        "\"DisplayIcon\"=\"C:\\\\Games\\\\FIFA \\\"2\\\"\\\\Gameloader.exe,0\"\n"
        "\"InstallLocation\"=str(2):\"D:\\\\Tr\\x00f2 ch\\x01a1i\\\\FIFA\"\n"
        "\"Long\"=\"C:\\\\a very long value that Wine \\\n"
        "  continues\\\\here\"\n"
        "\"EstimatedSize\"=dword:00001000\n"
        "\"Name\\u00e9\"=\"\\u1ea0\"\n"
        "[Software\\\\Wow6432Node\\\\Microsoft\\\\Windows\\\\CurrentVersion\\\\Uninstall\\\\X] 1\n"
        "\"InstallLocation\"=\"C:\\\\X\"\n"
        "[Software\\\\Other] 1\n"
        "\"InstallLocation\"=\"C:\\\\Not wanted\"\n";
    const RegistryFile file = ParseWineRegistry(
        text, {"Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\",
               "software\\wow6432node\\microsoft\\windows\\currentversion\\uninstall\\"});
    ASSERT_TRUE(file.problem.empty());
    EXPECT_EQ(file.arch, "win32");
    ASSERT_EQ(file.values.size(), 5u);
    EXPECT_EQ(file.values[0].key,
              "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\FIFA Online 2");
    EXPECT_EQ(file.values[0].value, "C:\\Games\\FIFA \"2\"\\Gameloader.exe,0");
    EXPECT_EQ(file.values[1].name, "InstallLocation");
    EXPECT_EQ(file.values[1].value, "D:\\Tr\xC3\xB2 ch\xC6\xA1i\\FIFA");
    EXPECT_EQ(file.values[2].value, "C:\\a very long value that Wine continues\\here");
    EXPECT_EQ(file.values[3].name, "Name\xC3\xA9");
    EXPECT_EQ(file.values[3].value, "\xE1\xBA\xA0");
    EXPECT_EQ(file.values[4].value, "C:\\X");

    EXPECT_FALSE(ParseWineRegistry("REGEDIT4\n", {""}).problem.empty());
    // A value cut off at the end of the file is dropped, not read past the end.
    EXPECT_TRUE(
        ParseWineRegistry("WINE REGISTRY Version 2\n[A] 1\n\"x\"=\"abc\\\n", {"A"}).values.empty());
}

TEST(DesktopEntryValue, ReadsTheMainGroupOnly) {
    const std::string text =
        "[Desktop Action x]\nExec=other\n[Desktop Entry]\nName=FIFA\n"
        "Exec=env WINEPREFIX=\"/h/.wine\" wine C:\\\\x.lnk\n";
    EXPECT_EQ(DesktopEntryValue(text, "Exec"), "env WINEPREFIX=\"/h/.wine\" wine C:\\\\x.lnk");
    EXPECT_EQ(DesktopEntryValue(text, "Icon"), "");
}

// Files cut off anywhere (a manager writing them, a full disk): a cut file is refused with a
// reason and gives no values, or gives only what the whole file holds; nothing is read past the
// end (the sanitizer build checks that) and no exception escapes.
TEST(ConfigReaders, EveryTruncationOfAFileIsRefusedOrReadAsFarAsItGoes) {
    const std::string yaml = "game:\n  exe: \"a\\u00e9\"\n  prefix: 'b''c'\nlist:\n- x\n- k: v\n";
    const std::string json = R"({"a": {"b": ["\ud83d\ude00", 1.5e3, true, null]}})";
    const std::string vdf = "// c\n\"a\" { \"path\" \"x\\\\y\" }\n";
    const std::string reg =
        "WINE REGISTRY Version 2\n#arch=win64\n[Software\\\\X] 1\n\"A\"=\"\\x00e9\\u1ea0\\\n b\"\n"
        "\"B\"=\"c\"\n";
    const std::string desktop = "[Desktop Entry]\nExec=env WINEPREFIX=/p wine x\n";
    const RegistryFile whole = ParseWineRegistry(reg, {"Software"});
    ASSERT_EQ(whole.values.size(), 2u);
    const std::string vdfEnd = vdf.substr(0, vdf.find('}') + 1);

    auto refusedOrRead = [](const Parsed& parsed, const std::string& cut) {
        EXPECT_TRUE(parsed.ok() || parsed.values.entries().empty()) << cut;
    };
    for (size_t n = 0; n < reg.size(); ++n) {
        const std::string yamlCut = yaml.substr(0, std::min(n, yaml.size()));
        const Parsed yamlParsed = ParseYaml(yamlCut);
        refusedOrRead(yamlParsed, yamlCut);
        // A quoted value is read whole or the file is refused; never half a value (a lone
        // opening quote at the very end reads as empty, which names nothing).
        if (const auto exe = yamlParsed.values.Find("game.exe"); exe && !exe->empty()) {
            EXPECT_EQ(*exe, "a\xC3\xA9") << yamlCut;
        }

        const std::string jsonCut = json.substr(0, std::min(n, json.size()));
        const Parsed jsonParsed = ParseJson(jsonCut);
        refusedOrRead(jsonParsed, jsonCut);
        EXPECT_EQ(jsonParsed.ok(), jsonCut == json) << jsonCut;

        const std::string vdfCut = vdf.substr(0, std::min(n, vdf.size()));
        const Parsed vdfParsed = ParseVdf(vdfCut);
        refusedOrRead(vdfParsed, vdfCut);
        EXPECT_EQ(vdfParsed.ok() && !vdfParsed.values.entries().empty(),
                  vdfCut.size() >= vdfEnd.size())
            << vdfCut;

        // Registry values of a cut file are values of the whole file: a value cut inside its
        // quotes is dropped, not read on into the next line or past the end.
        for (const RegistryValue& value :
             ParseWineRegistry(reg.substr(0, n), {"Software"}).values) {
            EXPECT_TRUE(std::any_of(whole.values.begin(), whole.values.end(),
                                    [&](const RegistryValue& full) {
                                        return full.name == value.name && full.value == value.value;
                                    }))
                << reg.substr(0, n);
        }
        const std::string exec =
            DesktopEntryValue(desktop.substr(0, std::min(n, desktop.size())), "Exec");
        EXPECT_TRUE(std::string_view("env WINEPREFIX=/p wine x").starts_with(exec)) << exec;
    }
}

}  // namespace
}  // namespace kickvane::game
