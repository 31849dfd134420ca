#include "engine/apply.h"

#include <gtest/gtest.h>
#ifndef _WIN32
#include <sys/stat.h>
#endif

#include <algorithm>

#include "platform/text.h"
#include "support/trees.h"

namespace kickvane::engine {
namespace {

using catalog::OptionArray;
using catalog::PatchSelection;
using testing::ReadText;
using testing::TempDir;
using testing::WriteFile;

class ApplyTest : public testing::ToolAndGameTest {
protected:
    ApplyOutcome Apply(const PatchSelection& selection, const std::string& suffix = "") {
        return ApplyPatches(tool(), game().string() + suffix, selection);
    }

    // Only the given categories on; the chosen variants stay at their defaults.
    static PatchSelection Only(std::initializer_list<int> categories) {
        PatchSelection selection = PatchSelection::Defaults();
        for (int i = 0; i < catalog::kCategoryCount; ++i) {
            selection.SetSwitchValue(
                i, static_cast<int>(std::count(categories.begin(), categories.end(), i)));
        }
        return selection;
    }
};

// The messages' exact words are checked where the user sees them, on the command line.
TEST_F(ApplyTest, FolderChecksStopTheRunWithTheirMessageBeforeAnyCopyOrSound) {
    fs::remove_all(game() / "data2");
    EXPECT_EQ(Apply(PatchSelection::Defaults()).stoppedBy, RootProblem::DataMissing);
    // A game folder that the system refuses for the length of its path is too long, not missing.
    const ApplyOutcome tooLong = Apply(PatchSelection::Defaults(), "/" + std::string(300, 'x'));
    EXPECT_EQ(tooLong.stoppedBy, RootProblem::DataTooLong);
    ASSERT_TRUE(tooLong.message);
    EXPECT_EQ(tooLong.message->text,
              "Đường dẫn thư mục chứa FIFA Online 2 quá dài\r\nVui lòng chọn thư mục ngắn hơn");

    // The tool's own base set is checked first.
    fs::remove_all(tool() / "data");
    const ApplyOutcome outcome = Apply(PatchSelection::Defaults());
    EXPECT_EQ(outcome.stoppedBy, RootProblem::ToolDataMissing);
    ASSERT_TRUE(outcome.message);
    EXPECT_EQ(outcome.message->kind, text::Message::Kind::Plain);
    EXPECT_TRUE(outcome.steps.empty());
    EXPECT_TRUE(outcome.signalSound.empty());
    EXPECT_FALSE(fs::exists(game() / "zdata/data2/ball"));
}

TEST_F(ApplyTest, NothingChosenStillPlaysTheSound) {
    const ApplyOutcome outcome = Apply(Only({}));
    EXPECT_TRUE(outcome.steps.empty());
    EXPECT_EQ(outcome.signalSound, tool() / "sound.wav");
}

TEST_F(ApplyTest, DefaultRunMergesIntoFoldersOfAnyCaseAndASecondRunCopiesNothing) {
    fs::create_directories(game() / "data2/teams");  // its make-folder step is not needed
    fs::remove_all(game() / "data2/players");        // not a rename: Wine keeps the old case then
    fs::create_directories(game() / "data2/Players");
    WriteFile(game() / "data2/Players/Kit/only_in_game.dds", "keep me");

    const ApplyOutcome first = Apply(PatchSelection::Defaults());
    EXPECT_TRUE(first.Failures().empty());
    EXPECT_EQ(ReadText(game() / "zdata/data2/ball/ball10.dds"), "europa ball");
    EXPECT_EQ(ReadText(game() / "data2/Players/Kit/base.dds"), "base players/kit");
    EXPECT_EQ(ReadText(game() / "data2/Players/Kit/only_in_game.dds"), "keep me");
    std::vector<std::string> playersFolders;  // one, in the game's spelling
    for (const fs::directory_entry& entry : fs::directory_iterator(game() / "data2")) {
        if (platform::FoldCase(entry.path().filename().string()) == "players") {
            playersFolders.push_back(entry.path().filename().string());
        }
    }
    EXPECT_EQ(playersFolders, std::vector<std::string>{"Players"});
    EXPECT_EQ(ReadText(game() / "data2/teams/emblems/base.dds"), "base teams/emblems");
    EXPECT_EQ(ReadText(game() / "data2/net/textures/base.dds"), "base net/textures");
    // The base set has no "gui\font": that one folder is skipped, the others are copied.
    EXPECT_FALSE(fs::exists(game() / "data2/gui/font"));
    EXPECT_TRUE(fs::exists(game() / "data2/gui/loading/base.dds"));
    int notNeeded = 0;
    for (const StepOutcome& step : first.steps) {
        notNeeded += step.state == StepState::NotNeeded ? 1 : 0;
    }
    EXPECT_EQ(notNeeded, 2);  // "make folder DataRoot\teams" and "gui\font"

    const ApplyOutcome second = Apply(PatchSelection::Defaults());
    ASSERT_EQ(second.steps.size(), first.steps.size());
    for (const StepOutcome& step : second.steps) {
        EXPECT_EQ(step.files.copied, 0) << Describe(step.step);
        EXPECT_NE(step.state, StepState::Failed) << Describe(step.step);
    }
}

TEST_F(ApplyTest, FailedStepsAreListedWithAReasonAndTheRunGoesOn) {
    fs::remove_all(game() / "zdata");
    fs::create_directories(game() / "data2/cmn/base.dds");  // a folder where the file goes
    PatchSelection selection = PatchSelection::Defaults();
    selection.SetSwitchValue(12, 1);
    selection.SetSwitchValue(13, 1);
    selection.SetOptionValue(OptionArray::Other, 5, true);  // pitch Caro
    const ApplyOutcome outcome = Apply(selection);

    ASSERT_FALSE(outcome.Stopped());
    for (const StepOutcome& step : outcome.steps) {
        const bool blocked = step.step.target.root == Root::ZData || step.step.category == 5;
        EXPECT_EQ(step.state == StepState::Failed, blocked) << Describe(step.step);
        EXPECT_EQ(static_cast<bool>(step.failure.code), blocked) << Describe(step.step);
    }
    EXPECT_EQ(outcome.Failures().size(), 5u);
    EXPECT_EQ(ReadText(game() / "data2/gui/hud/Indicator/base.dds"), "base gui/hud/Indicator");
    EXPECT_FALSE(outcome.signalSound.empty());
}

// A pitch variant leaves its own grass and the shared textures in the main tree, with the base
// set's dirt and lines over the variant's, and the second tree's pitch back at the base set; it
// touches nothing else in the game.
TEST_F(ApplyTest, PitchVariantEndsWithTheBaseSetsDirtAndLines) {
    // An earlier run's pitch in the second tree is overwritten, not kept.
    WriteFile(game() / "zdata/data2/pitch/zbase.dds", "earlier variant");
    PatchSelection selection = Only({1});
    selection.SetOptionValue(OptionArray::Other, 5, true);
    // A trailing separator on the game folder names the same folders.
    EXPECT_TRUE(Apply(selection, "/").Failures().empty());
    const fs::path textures = game() / "data2/pitch/textures";
    EXPECT_EQ(ReadText(textures / "grass.dds"), "caro grass");
    EXPECT_EQ(ReadText(textures / "shadow.dds"), "shared shadow");
    EXPECT_EQ(ReadText(textures / "grass_dirt.dds"), "base dirt");
    EXPECT_EQ(ReadText(textures / "grass_pitchlines.dds"), "base lines");
    EXPECT_EQ(ReadText(game() / "zdata/data2/pitch/zbase.dds"), "zbase pitch");

    std::vector<std::string> files;
    for (const auto& entry : fs::recursive_directory_iterator(game())) {
        if (entry.is_regular_file()) {
            files.push_back(entry.path().lexically_relative(game()).generic_string());
        }
    }
    std::sort(files.begin(), files.end());
    EXPECT_EQ(files, (std::vector<std::string>{
                         "data2/pitch/textures/grass.dds", "data2/pitch/textures/grass_dirt.dds",
                         "data2/pitch/textures/grass_pitchlines.dds",
                         "data2/pitch/textures/shadow.dds", "zdata/data2/pitch/zbase.dds"}));
}

// A missing parent of the target fails the copy too; the failed steps above show that.
TEST(FileSteps, MergeCopyFindsItsSourceInAnyCase_MakeFolderNeedsAParentAndNoFolderOfThatName) {
    TempDir dir;
    WriteFile(dir / "src/sub/a.dds", "a");
    EXPECT_FALSE(MergeCopy(dir / "missing", dir / "dst").ok());
    EXPECT_FALSE(fs::exists(dir / "dst"));
    const Status tooLong = MergeCopy(dir / "src", dir / std::string(300, 'x') / "dst");
    EXPECT_EQ(tooLong.failure().cause(), FailureCause::NameTooLong) << tooLong.reason();

    // A temporary file that nothing locks but that changed a moment ago may be one whose writer
    // (another apply) is about to lock it: it stays. Older ones go; the platform's tests show
    // that.
    WriteFile(dir / "dst/sub/.a.dds.kv-Ab12Cd", "half a texture");
    CopyCount count;
    ASSERT_TRUE(MergeCopy(dir / "SRC", dir / "dst", &count).ok());
    EXPECT_EQ(ReadText(dir / "dst/sub/a.dds"), "a");
    EXPECT_EQ(count.copied, 1);
    EXPECT_EQ(ReadText(dir / "dst/sub/.a.dds.kv-Ab12Cd"), "half a texture");

    // A folder is made only where none exists in any case and its parent does.
    fs::create_directories(dir / "Teams");
    EXPECT_FALSE(MakeFolder(dir / "teams").ok());
    EXPECT_FALSE(MakeFolder(dir / "b/c").ok());
    EXPECT_TRUE(MakeFolder(dir / "teams/emblems").ok());
    EXPECT_TRUE(fs::is_directory(dir / "Teams/emblems"));
}

// A large folder is copied several files at once; the outcome is the same as one at a time.
TEST(MergeCopy, LargeFolderIsCopiedWholeAndItsFirstFailureInNameOrderIsReported) {
    TempDir dir;
    for (int i = 0; i < 200; ++i) {
        WriteFile(dir / "src" / ("tex_" + std::to_string(1000 + i) + ".dds"), std::to_string(i));
    }
    WriteFile(dir / "dst/TEX_1007.DDS", "old");  // kept in its own spelling
    CopyCount count;
    ASSERT_TRUE(MergeCopy(dir / "src", dir / "dst", &count).ok());
    EXPECT_EQ(count.copied, 200);
    EXPECT_EQ(ReadText(dir / "dst/TEX_1007.DDS"), "7");
    EXPECT_EQ(ReadText(dir / "dst/tex_1199.dds"), "199");
    EXPECT_EQ(std::distance(fs::directory_iterator(dir / "dst"), {}), 200);
    count = {};
    ASSERT_TRUE(MergeCopy(dir / "src", dir / "dst", &count).ok());
    EXPECT_EQ(count.upToDate, 200);

#ifndef _WIN32
    // Pipes are no files to copy: the run stops, naming the first of them.
    for (const char* pipe : {"tex_1170.dds", "tex_1050.dds"}) {
        fs::remove(dir / "src" / pipe);
        ASSERT_EQ(::mkfifo((dir / "src" / pipe).c_str(), 0644), 0);
    }
    const Status failed = MergeCopy(dir / "src", dir / "fresh");
    EXPECT_NE(failed.reason().find("tex_1050.dds"), std::string::npos) << failed.reason();
#endif
}

// The files of many small folders are copied several at once across folders; the outcome is the
// one of a copy in name order, folder by folder, files before subfolders.
TEST(MergeCopy, TreeOfManySmallFoldersIsCopiedWholeInTheOrderOfOneAtATime) {
    TempDir dir;
    auto name = [](int i) { return "f" + std::string(i < 10 ? "0" : "") + std::to_string(i); };
    for (int f = 0; f < 60; ++f) {
        for (int i = 0; i < 4; ++i) {
            WriteFile(dir / "src" / name(f) / ("t" + std::to_string(i) + ".dds"), name(f));
            WriteFile(dir / "src" / name(f) / "sub" / ("s" + std::to_string(i) + ".dds"), "s");
        }
    }
#ifndef _WIN32
    // Two names of one file where letter case is ignored (the source lies on a file system that
    // tells them apart): the last in name order wins.
    WriteFile(dir / "src/f07/T0.DDS", "upper");
    constexpr int kCollisions = 1;
#else
    constexpr int kCollisions = 0;
#endif
    CopyCount count;
    ASSERT_TRUE(MergeCopy(dir / "src", dir / "dst", &count).ok());
    EXPECT_EQ(count.copied, 60 * 8 + kCollisions);
    EXPECT_EQ(ReadText(dir / "dst/f59/sub/s3.dds"), "s");
    EXPECT_EQ(ReadText(dir / "dst/f31/t2.dds"), "f31");
    // Again: both names now land on the first spelling, and the last in name order wins.
    count = {};
    ASSERT_TRUE(MergeCopy(dir / "src", dir / "dst", &count).ok());
    EXPECT_EQ(count.upToDate, 60 * 8);
    EXPECT_EQ(count.copied, kCollisions);
    EXPECT_EQ(ReadText(dir / (kCollisions ? "dst/f07/T0.DDS" : "dst/f07/t0.dds")), "f07");

#ifndef _WIN32
    // The first failure in that order is reported: a subfolder's file before a later folder's.
    for (const char* pipe : {"f40/t1.dds", "f05/sub/s2.dds", "f05/sub/s3.dds"}) {
        fs::remove(dir / "src" / pipe);
        ASSERT_EQ(::mkfifo((dir / "src" / pipe).c_str(), 0644), 0);
    }
    const Status failed = MergeCopy(dir / "src", dir / "fresh");
    EXPECT_NE(failed.reason().find("s2.dds"), std::string::npos) << failed.reason();
    EXPECT_EQ(ReadText(dir / "fresh/f05/t3.dds"), "f05");  // what came before stays
#endif
}

}  // namespace
}  // namespace kickvane::engine
