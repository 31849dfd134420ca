#include "engine/quick_load.h"

#include <gtest/gtest.h>

#include "support/trees.h"

namespace kickvane::engine {
namespace {

namespace fs = std::filesystem;
using testing::ReadText;
using testing::WriteFile;

// The tool's folders that quick load fills, and a source folder beside it.
class QuickLoadTest : public testing::ToolAndGameTest {
protected:
    fs::path source() const { return dir_ / "source"; }
    fs::path heads() const { return tool() / "data/data2/players/heads"; }

    QuickLoadOutcome Load() { return QuickLoad(tool(), source()); }
};

TEST_F(QuickLoadTest, DirectFilesGoFirstAndNestedFormsOnlyWhereNoDirectFileMatches) {
    WriteFile(source() / "notes.txt", "a plain file that matches no pattern");
    WriteFile(source() / "CM_2.DDS", "top cm");
    WriteFile(source() / "Heads/Textures/cm_9.dds", "nested cm");
    WriteFile(source() / "Heads/Textures/face7.dds", "nested face");
    WriteFile(source() / "Heads/Textures/.face8.dds", "hidden");
    WriteFile(source() / "bodies/textures/skin3.dds", "nested skin");
    WriteFile(source() / "Textures/Ball10.dds", "nested ball");
    const QuickLoadOutcome outcome = Load();
    EXPECT_TRUE(outcome.Ok());
    EXPECT_FALSE(outcome.message);

    EXPECT_EQ(ReadText(heads() / "textures/CM_2.DDS"), "top cm");
    EXPECT_FALSE(fs::exists(heads() / "textures/cm_9.dds"));
    EXPECT_EQ(ReadText(heads() / "textures/face7.dds"), "nested face");
    EXPECT_FALSE(fs::exists(heads() / "textures/.face8.dds"));
    EXPECT_EQ(ReadText(tool() / "data/data2/players/bodies/textures/skin3.dds"), "nested skin");
    EXPECT_EQ(ReadText(tool() / "data/zdata/data2/ball/textures/Ball10.dds"), "nested ball");
}

// No folder chosen is told apart from a folder with nothing to take: only subfolders (their
// files count only beside a plain file at the top), or files that no pattern matches.
TEST_F(QuickLoadTest, NoFolderOrNoMatchingFileStopsWithItsMessage) {
    const QuickLoadOutcome none = QuickLoad(tool(), fs::path());
    EXPECT_TRUE(none.stopped);
    WriteFile(source() / "heads/textures/face1.dds", "nested only");
    WriteFile(source() / ".hidden", "x");
    const QuickLoadOutcome outcome = Load();

    EXPECT_TRUE(outcome.stopped);
    ASSERT_TRUE(none.message);
    EXPECT_EQ(none.message->text, "Bạn chưa chọn thư mục nào!");
    ASSERT_TRUE(outcome.message);
    EXPECT_EQ(outcome.message->text, "Thư mục này không có file Face hay Ball nào");
    EXPECT_FALSE(fs::exists(heads() / "textures/face1.dds"));

    fs::remove_all(source() / "heads");
    WriteFile(source() / "readme.txt", "no face here");
    WriteFile(source() / "ball11.dds", "not ours");
    const QuickLoadOutcome unmatched = Load();
    EXPECT_TRUE(unmatched.stopped);
    ASSERT_TRUE(unmatched.message);
    EXPECT_EQ(unmatched.message->text, "Thư mục này không có file Face hay Ball nào");
}

TEST_F(QuickLoadTest, FailedPatternIsNamedAndTheOthersGoOn) {
    fs::remove_all(tool() / "data/data2/players/bodies");
    WriteFile(source() / "skin1.dds", "skin");
    WriteFile(source() / "face1.dds", "face");
    WriteFile(source() / "hhead1.pc.ea3.em", "head model");
    const QuickLoadOutcome outcome = Load();

    ASSERT_EQ(outcome.failures.size(), 1u);
    EXPECT_EQ(outcome.failures[0].pattern, "skin*.dds");
    EXPECT_EQ(outcome.failures[0].failure.action, FailedAction::CopyInto);
    EXPECT_TRUE(fs::exists(heads() / "textures/face1.dds"));
    EXPECT_TRUE(fs::exists(heads() / "hhead1.pc.ea3.em"));
    EXPECT_FALSE(outcome.stopped);
}

TEST(MatchesWildcard, FollowsWindowsRulesWithoutCase) {
    EXPECT_TRUE(MatchesWildcard("CM_.DDS", "cm_*.dds"));
    EXPECT_TRUE(MatchesWildcard("hhead5.pc.ea3.em", "hhead*.pc.ea3.em"));
    EXPECT_TRUE(MatchesWildcard("face.x.dds", "face*.dds"));
    EXPECT_TRUE(MatchesWildcard("a1", "a?"));
    // Wildcards in a file's name are plain characters there.
    EXPECT_TRUE(MatchesWildcard("cm_*x.dds", "cm_*.dds"));
    EXPECT_TRUE(MatchesWildcard("face?*.dds", "face*.dds"));
    EXPECT_FALSE(MatchesWildcard("a*", "a?b"));
    EXPECT_FALSE(MatchesWildcard("face1.dds.bak", "face*.dds"));
    EXPECT_FALSE(MatchesWildcard("xcm_1.dds", "cm_*.dds"));
}

}  // namespace
}  // namespace kickvane::engine
