#include "engine/apply.h"

#include <gtest/gtest.h>

#include "fake_ui.h"
#include "support/trees.h"

namespace kickvane::engine {
namespace {

using catalog::OptionArray;
using catalog::PatchSelection;
using testing::FakeUi;
using testing::ReadText;
using testing::TempDir;
using testing::WriteFile;

class ApplyTest : public ::testing::Test {
protected:
    void SetUp() override {
        testing::MakeToolFolder(tool());
        testing::MakeGameFolder(game());
    }

    fs::path tool() const { return dir_ / "tool"; }
    fs::path game() const { return dir_ / "game"; }

    ApplyOutcome Apply(const PatchSelection& selection) {
        return ApplyPatches(tool(), game().string(), selection, ui_);
    }

    static PatchSelection AllOff() {
        PatchSelection selection = PatchSelection::Defaults();
        for (int i = 0; i < catalog::kCategoryCount; ++i) {
            selection.setSwitchValue(i, 0);
        }
        return selection;
    }

    TempDir dir_;
    FakeUi ui_;
};

TEST_F(ApplyTest, MissingToolBaseSetStopsWithThePlainMessageFirst) {
    fs::remove_all(tool() / "data");
    fs::remove_all(game() / "data2");
    const ApplyOutcome outcome = Apply(PatchSelection::Defaults());

    EXPECT_EQ(outcome.stoppedBy, RootProblem::ToolDataMissing);
    ASSERT_EQ(ui_.plain.size(), 1u);
    EXPECT_EQ(ui_.plain[0], "Thu muc nguon|Khong tim thay: " + (tool() / "data/data2").string() +
                                "\r\nKiem tra lai duong dan");
    EXPECT_TRUE(ui_.messages.shown.empty());
    EXPECT_TRUE(ui_.sounds.empty());
    EXPECT_TRUE(outcome.steps.empty());
}

TEST_F(ApplyTest, MissingGameDataStopsWithTheConvertedMessageAndNoSound) {
    fs::remove_all(game() / "data2");
    const ApplyOutcome outcome = Apply(PatchSelection::Defaults());

    EXPECT_EQ(outcome.stoppedBy, RootProblem::DataMissing);
    ASSERT_EQ(ui_.messages.shown.size(), 1u);
    EXPECT_EQ(ui_.messages.shown[0],
              "Không tìm thấy thư mục chứa FIFA Online 2\r\nVui lòng kiểm tra lại đường dẫn");
    EXPECT_TRUE(ui_.sounds.empty());
    EXPECT_FALSE(fs::exists(game() / "zdata/data2/ball"));
}

TEST_F(ApplyTest, AllCategoriesOffCopiesNothingButPlaysTheSound) {
    const ApplyOutcome outcome = Apply(AllOff());
    EXPECT_TRUE(outcome.steps.empty());
    ASSERT_EQ(ui_.sounds.size(), 1u);
    EXPECT_EQ(ui_.sounds[0], tool() / "sound.wav");
}

TEST_F(ApplyTest, DefaultRunCopiesEverySetAndASecondRunChangesNothing) {
    fs::create_directories(game() / "data2/teams");  // emblems missing: only the second mkdir runs
    fs::rename(game() / "data2/players", game() / "data2/Players");
    WriteFile(game() / "data2/Players/Kit/only_in_game.dds", "keep me");

    const ApplyOutcome first = Apply(PatchSelection::Defaults());
    EXPECT_TRUE(first.Failures().empty());
    EXPECT_EQ(ReadText(game() / "zdata/data2/ball/ball10.dds"), "europa ball");
    // Merged into the folders that exist under another letter case.
    EXPECT_EQ(ReadText(game() / "data2/Players/Kit/base.dds"), "base players/kit");
    EXPECT_EQ(ReadText(game() / "data2/Players/Kit/only_in_game.dds"), "keep me");
    EXPECT_FALSE(fs::exists(game() / "data2/players"));
    EXPECT_EQ(ReadText(game() / "data2/teams/emblems/base.dds"), "base teams/emblems");
    EXPECT_EQ(ReadText(game() / "data2/net/textures/base.dds"), "base net/textures");
    // The base set has no "gui\font": that one folder is skipped, the others are copied.
    EXPECT_FALSE(fs::exists(game() / "data2/gui/font"));
    EXPECT_TRUE(fs::exists(game() / "data2/gui/loading/base.dds"));
    EXPECT_FALSE(fs::exists(game() / "zdata/data2/crowd"));

    const ApplyOutcome second = Apply(PatchSelection::Defaults());
    ASSERT_EQ(second.steps.size(), first.steps.size());
    for (const StepOutcome& step : second.steps) {
        EXPECT_EQ(step.files.copied, 0) << Describe(step.step);
        EXPECT_NE(step.state, StepState::Failed) << Describe(step.step);
    }
    EXPECT_EQ(ui_.sounds.size(), 2u);
}

TEST_F(ApplyTest, MissingSecondTreeFailsOnlyItsCopiesAndTheRunGoesOn) {
    fs::remove_all(game() / "zdata");
    PatchSelection selection = PatchSelection::Defaults();
    selection.setSwitchValue(12, 1);
    selection.setSwitchValue(13, 1);
    selection.setOptionValue(OptionArray::UniOption1, 5, true);  // pitch Caro: step 5 goes to zdata
    const ApplyOutcome outcome = Apply(selection);

    std::vector<std::string> failed;
    for (const StepOutcome& step : outcome.Failures()) {
        failed.push_back(Describe(step.step));
        EXPECT_FALSE(step.reason.empty());
    }
    EXPECT_EQ(failed, (std::vector<std::string>{
                          "merge ExtrasFolder\\Ball\\Europa League 2011 -> ZDataRoot\\ball",
                          "merge ToolZDataRoot\\pitch -> ZDataRoot\\pitch",
                          "merge ToolZDataRoot\\crowd\\textures -> ZDataRoot\\crowd\\textures",
                          "merge ToolZDataRoot\\stadiums -> ZDataRoot\\stadiums"}));
    EXPECT_EQ(ReadText(game() / "data2/gui/hud/Indicator/base.dds"), "base gui/hud/Indicator");
    EXPECT_EQ(ui_.sounds.size(), 1u);
}

TEST_F(ApplyTest, PitchVariantEndsWithTheBaseSetsDirtAndLines) {
    PatchSelection selection = AllOff();
    selection.setSwitchValue(1, 1);
    selection.setOptionValue(OptionArray::UniOption1, 5, true);
    const ApplyOutcome outcome = Apply(selection);

    EXPECT_TRUE(outcome.Failures().empty());
    EXPECT_EQ(ReadText(game() / "data2/pitch/textures/grass.dds"), "caro grass");
    EXPECT_EQ(ReadText(game() / "data2/pitch/textures/shadow.dds"), "shared shadow");
    EXPECT_EQ(ReadText(game() / "data2/pitch/textures/grass_dirt.dds"), "base dirt");
    EXPECT_EQ(ReadText(game() / "data2/pitch/textures/grass_pitchlines.dds"), "base lines");
}

TEST_F(ApplyTest, FileThatCannotBeReplacedFailsItsStepOnly) {
    fs::create_directories(game() / "data2/cmn/base.dds");  // a folder where the file goes
    PatchSelection selection = AllOff();
    selection.setSwitchValue(5, 1);
    selection.setSwitchValue(8, 1);
    const ApplyOutcome outcome = Apply(selection);

    ASSERT_EQ(outcome.Failures().size(), 1u);
    EXPECT_EQ(outcome.Failures()[0].step.category, 5);
    EXPECT_EQ(ReadText(game() / "data2/players/kit/base.dds"), "base players/kit");
}

TEST_F(ApplyTest, GameFolderWithTrailingSeparatorNamesTheSameFolders) {
    PatchSelection selection = AllOff();
    selection.setSwitchValue(5, 1);
    const ApplyOutcome outcome = ApplyPatches(tool(), game().string() + "/", selection, ui_);
    EXPECT_FALSE(outcome.stopped());
    EXPECT_TRUE(fs::exists(game() / "data2/cmn/base.dds"));
}

TEST(MergeCopy, CreatesTargetButNotItsParentAndFailsOnMissingSource) {
    TempDir dir;
    WriteFile(dir / "src/sub/a.dds", "a");
    EXPECT_FALSE(MergeCopy(dir / "src", dir / "no/parent").ok());
    EXPECT_FALSE(fs::exists(dir / "no"));
    EXPECT_FALSE(MergeCopy(dir / "missing", dir / "dst").ok());
    EXPECT_FALSE(fs::exists(dir / "dst"));

    CopyCount count;
    ASSERT_TRUE(MergeCopy(dir / "SRC", dir / "dst", &count).ok());
    EXPECT_EQ(ReadText(dir / "dst/sub/a.dds"), "a");
    EXPECT_EQ(count.copied, 1);
}

TEST(MakeFolder, FailsWhenTheFolderExistsInAnyCase) {
    TempDir dir;
    fs::create_directories(dir / "Teams");
    EXPECT_FALSE(MakeFolder(dir / "teams").ok());
    EXPECT_TRUE(MakeFolder(dir / "teams/emblems").ok());
    EXPECT_TRUE(fs::is_directory(dir / "Teams/emblems"));
}

}  // namespace
}  // namespace kickvane::engine
