#include "skin/gallery.h"

#include <filesystem>
#include <set>
#include <sstream>

#include <gtest/gtest.h>
#include <QImage>

namespace kickvane::skin {
namespace {

namespace fs = std::filesystem;

TEST(GalleryTest, RunSkinGallery_WritesASheetThatIsNotBlank_OrReportsAFileItCannotWrite) {
    const fs::path out =
        fs::temp_directory_path() /
        ("kickvane-skin-gallery-" +
         std::to_string(::testing::UnitTest::GetInstance()->random_seed()) + ".png");
    std::ostringstream err;
    ASSERT_EQ(RunSkinGallery(out, err), 0) << err.str();
    EXPECT_TRUE(err.str().empty());

    const QImage sheet(QString::fromStdString(out.string()));
    fs::remove(out);
    ASSERT_FALSE(sheet.isNull());
    EXPECT_GE(sheet.height(), 600);
    std::set<QRgb> colours;
    for (int y = 0; y < sheet.height(); y += 3) {
        for (int x = 0; x < sheet.width(); x += 3) {
            colours.insert(sheet.pixel(x, y));
        }
    }
    EXPECT_GT(colours.size(), 200u);

    std::ostringstream unwritable;
    EXPECT_NE(RunSkinGallery("/nonexistent-folder/sheet.png", unwritable), 0);
    EXPECT_NE(unwritable.str().find("cannot write"), std::string::npos);
}

}  // namespace
}  // namespace kickvane::skin
