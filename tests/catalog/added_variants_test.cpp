#include "catalog/added_variants.h"

#include <gtest/gtest.h>

#include "catalog/settings.h"

#ifndef _WIN32
#include <unistd.h>
#endif
#include "support/temp_dir.h"

namespace kickvane::catalog {
namespace {

namespace fs = std::filesystem;
using testing::ReadText;
using testing::TempDir;
using testing::WriteFile;

// A set folder with one file, as a player drops it beside the others.
void AddSet(const TempDir& tool, std::string_view group, std::string_view name) {
    WriteFile(tool.path() / "extras" / group / fs::path(std::u8string(name.begin(), name.end())) /
                  "texture.dds",
              "x");
}

std::vector<std::string> Names(const AddedVariants& list, GroupId group) {
    std::vector<std::string> names;
    for (const AddedVariant& variant : list.Of(group)) {
        names.push_back(variant.name);
    }
    return names;
}

std::vector<std::pair<std::string, SkipReason>> Skips(const AddedVariants& list, GroupId group) {
    std::vector<std::pair<std::string, SkipReason>> skips;
    for (const SkippedFolder& skipped : list.Skipped(group)) {
        skips.emplace_back(skipped.name, skipped.reason);
    }
    return skips;
}

TEST(AddedVariants, FoldersBesideTheCatalogsSetsAreVariantsOfTheirGroup) {
    TempDir tool;
    AddSet(tool, "Ball", "UCL 2011");  // the catalog's own
    AddSet(tool, "Ball", "World Cup 2026");
    AddSet(tool, "Ball", "Bóng Tết");
    AddSet(tool, "scoreboard", "ESPN HD");
    WriteFile(tool / "extras/scoreboard/BBC/scoreboard/sb.dds", "x");  // a file one level down
    AddSet(tool, "pitch", "_textures");                                // shared, not a variant
    AddSet(tool, "pitch", "Sọc");
    AddSet(tool, "adboard", "V-League");
    // The group folders are found in any letter case, as the copy finds them.
    AddSet(tool, "INDICATOR", "Mũi tên");

    const AddedVariants list = AddedVariants::List(tool.path());
    EXPECT_EQ(Names(list, GroupId::Ball), (std::vector<std::string>{"Bóng Tết", "World Cup 2026"}));
    EXPECT_EQ(Names(list, GroupId::Scoreboard), std::vector<std::string>{"BBC"});
    EXPECT_EQ(Names(list, GroupId::Pitch), std::vector<std::string>{"Sọc"});
    EXPECT_EQ(Names(list, GroupId::Adboard), std::vector<std::string>{"V-League"});
    EXPECT_EQ(Names(list, GroupId::Mark), std::vector<std::string>{"Mũi tên"});
    for (const VariantGroup& group : Groups()) {
        EXPECT_TRUE(list.Skipped(group.id).empty());
        EXPECT_EQ(list.FolderState(group.id), GroupFolderState::Listed);
    }
    EXPECT_EQ(list.Of(GroupId::Mark)[0].SourceFolder(), "\\Indicator\\Mũi tên");
}

TEST(AddedVariants, FoldersThatCannotBeAChoiceAreSkippedAndNamed) {
    TempDir tool;
    const fs::path balls = tool / "extras/Ball";
    fs::create_directories(balls / "Empty" / "sub");         // folders but no file
    WriteFile(balls / "notes.txt", "a file, not a folder");  // a file
    AddSet(tool, "Ball", "a=b");                             // cannot be a key
    AddSet(tool, "Ball", "[x]");
    AddSet(tool, "Ball", "; comment");
    AddSet(tool, "Ball", " padded");
    AddSet(tool, "Ball", "MacDinh");  // a catalog key of the section
    AddSet(tool, "Ball", "macdinh2");
    AddSet(tool, "Ball", "_draft");
    AddSet(tool, "Ball", ".hidden");
    AddSet(tool, "pitch", "CoCaro");  // pitch key, in section "Khac"
    AddSet(tool, "adboard", "Shared");
    AddSet(tool, "Indicator", "shared");  // adboard has the key in "Khac"

    const AddedVariants list = AddedVariants::List(tool.path());
    EXPECT_EQ(Names(list, GroupId::Ball), std::vector<std::string>{"macdinh2"});
    using R = SkipReason;
    EXPECT_EQ(Skips(list, GroupId::Ball), (std::vector<std::pair<std::string, SkipReason>>{
                                              {" padded", R::NotAKey},
                                              {"; comment", R::NotAKey},
                                              {"Empty", R::Empty},
                                              {"MacDinh", R::CatalogKey},
                                              {"[x]", R::NotAKey},
                                              {"_draft", R::Underscore},
                                              {"a=b", R::NotAKey},
                                              {"notes.txt", R::NotAFolder},
                                          }));
    EXPECT_EQ(Skips(list, GroupId::Pitch),
              (std::vector<std::pair<std::string, SkipReason>>{{"CoCaro", R::CatalogKey}}));
    EXPECT_EQ(Names(list, GroupId::Adboard), std::vector<std::string>{"Shared"});
    EXPECT_EQ(Skips(list, GroupId::Mark),
              (std::vector<std::pair<std::string, SkipReason>>{{"shared", R::TakenInSection}}));
}

TEST(AddedVariants, CatalogSetUnderAnotherCaseIsTheCatalogsOwnNotAnAddedOne) {
    TempDir tool;
    AddSet(tool, "adboard", "viet nam");  // the only spelling there: the copy uses it
    const AddedVariants list = AddedVariants::List(tool.path());
    EXPECT_TRUE(list.Of(GroupId::Adboard).empty());
    EXPECT_TRUE(list.Skipped(GroupId::Adboard).empty());
    EXPECT_TRUE(AddedVariants::List(tool / "no such tool").empty());
}

#ifndef _WIN32
// Names only a file system that tells letter case apart can hold, links, and folders that
// cannot be read.
TEST(AddedVariants, CaseTwinsLongNamesLinksAndUnreadableFolders) {
    TempDir tool;
    TempDir elsewhere;
    const fs::path balls = tool / "extras/Ball";
    AddSet(tool, "Ball", "ucl 2011");  // the catalog's set in other case, beside the real one
    AddSet(tool, "Ball", "UCL 2011");
    AddSet(tool, "Ball", "Mine");
    AddSet(tool, "Ball", "MINE");                 // same key as "Mine"
    AddSet(tool, "Ball", std::string(255, 'b'));  // the longest name: fine
    WriteFile(elsewhere / "Shared Ball/ball.dds", "x");
    fs::create_symlink(elsewhere / "Shared Ball", balls / "Linked");  // followed
    fs::create_symlink(tool / "nowhere", balls / "Dangling");
    fs::create_directories(tool / "extras/pitch/Locked");
    fs::permissions(tool / "extras/pitch/Locked", fs::perms::none);
    fs::create_directories(tool / "extras/adboard");
    fs::permissions(tool / "extras/adboard", fs::perms::none);

    const AddedVariants list = AddedVariants::List(tool.path());
    EXPECT_EQ(Names(list, GroupId::Ball),
              (std::vector<std::string>{"Linked", "MINE", std::string(255, 'b')}));
    using R = SkipReason;
    EXPECT_EQ(Skips(list, GroupId::Ball), (std::vector<std::pair<std::string, SkipReason>>{
                                              {"Dangling", R::NotAFolder},
                                              {"Mine", R::CaseTwin},
                                              {"ucl 2011", R::CaseTwin},
                                          }));
    EXPECT_EQ(list.FolderState(GroupId::Mark), GroupFolderState::Missing);
    if (::geteuid() != 0) {  // root reads any folder
        EXPECT_EQ(Skips(list, GroupId::Pitch),
                  (std::vector<std::pair<std::string, SkipReason>>{{"Locked", R::Unreadable}}));
        EXPECT_EQ(list.FolderState(GroupId::Adboard), GroupFolderState::Unreadable);
    }
    fs::permissions(tool / "extras/pitch/Locked", fs::perms::owner_all);
    fs::permissions(tool / "extras/adboard", fs::perms::owner_all);
}
#endif

// Settings with the player's own variants.

AddedVariants OneOfEach() {
    AddedVariants added;
    added.Add({GroupId::Ball, "Bóng Tết"});
    added.Add({GroupId::Ball, "World Cup 2026"});
    added.Add({GroupId::Pitch, "Sọc"});
    added.Add({GroupId::Mark, "Mũi tên"});
    return added;
}

TEST(AddedVariantSettings, ChosenAddedVariantsRoundTripAfterTheCatalogKeys) {
    TempDir tool;
    const AddedVariants added = OneOfEach();
    Settings saved{"C:\\Games", "F7", PatchSelection::Defaults()};
    saved.selection.SetAddedValue(GroupId::Ball, "World Cup 2026", true);
    saved.selection.SetAddedValue(GroupId::Pitch, "Sọc", true);
    ASSERT_TRUE(SaveSettings(tool.path(), saved, added).ok());

    const std::string text = ReadText(tool / "ThietLap.ini");
    EXPECT_NE(text.find("UCL 2011=False\r\nBóng Tết=False\r\nWorld Cup 2026=True\r\n[Bang Ti So]"),
              std::string::npos);
    EXPECT_NE(text.find("MarkPESvang=False\r\nSọc=True\r\nMũi tên=False\r\n"), std::string::npos);
    EXPECT_NE(text.find("CoMacDinh=False\r\n"), std::string::npos);

    const LoadedSettings loaded = LoadSettings(tool.path(), added);
    EXPECT_EQ(loaded.settings.selection, saved.selection);
    EXPECT_TRUE(loaded.gone.empty());
    // The adboard's and mark's catalog choices stayed, although they share the section.
    EXPECT_EQ(loaded.settings.selection.Chosen(GroupId::Mark), 8);
}

TEST(AddedVariantSettings, GoneChosenVariantFallsBackToTheDefaultAndIsDroppedAtTheNextSave) {
    TempDir tool;
    AddedVariants before = OneOfEach();
    Settings saved{"C:\\Games", "F7", PatchSelection::Defaults()};
    saved.selection.SetAddedValue(GroupId::Ball, "World Cup 2026", true);
    saved.selection.SetAddedValue(GroupId::Mark, "Mũi tên", true);
    ASSERT_TRUE(SaveSettings(tool.path(), saved, before).ok());

    AddedVariants after;  // the ball's and the mark's folders are gone, the pitch's stays
    after.Add({GroupId::Pitch, "Sọc"});
    const LoadedSettings loaded = LoadSettings(tool.path(), after);
    EXPECT_EQ(loaded.gone, (std::vector<GoneChoice>{{GroupId::Ball, "World Cup 2026"},
                                                    {GroupId::Mark, "Mũi tên"}}));
    EXPECT_EQ(loaded.settings.selection.ChosenOption(GroupId::Ball)->key, "Europa League 2011");
    EXPECT_EQ(loaded.settings.selection.ChosenOption(GroupId::Mark)->key, "MarkMacDinh");
    EXPECT_EQ(loaded.settings.selection.ChosenOption(GroupId::Pitch)->key, "CoMacDinh");

    ASSERT_TRUE(SaveSettings(tool.path(), loaded.settings, after).ok());
    const std::string text = ReadText(tool / "ThietLap.ini");
    EXPECT_EQ(text.find("World Cup 2026"), std::string::npos);
    EXPECT_EQ(text.find("Bóng Tết"), std::string::npos);
    EXPECT_NE(text.find("Sọc=False"), std::string::npos);
    EXPECT_TRUE(LoadSettings(tool.path(), after).gone.empty());  // said once only
}

TEST(AddedVariantSettings, GoneVariantThatWasNotChosenChangesNothing) {
    TempDir tool;
    WriteFile(tool / "ThietLap.ini",
              "[Bong]\r\nMacDinh=False\r\nEuropa League 2011=False\r\nUCL 2011=True\r\n"
              "Old Ball=False\r\n");
    const LoadedSettings loaded = LoadSettings(tool.path(), OneOfEach());
    EXPECT_TRUE(loaded.gone.empty());
    EXPECT_EQ(loaded.settings.selection.Chosen(GroupId::Ball), 3);
}

}  // namespace
}  // namespace kickvane::catalog
