#include "skin/gallery.h"

#include <algorithm>
#include <filesystem>
#include <set>
#include <sstream>
#include <string>

#include <gtest/gtest.h>
#include <QByteArray>
#include <QImage>

namespace kickvane::skin {
namespace {

namespace fs = std::filesystem;

fs::path tempSheet(const std::string& name) {
    return fs::temp_directory_path() /
           ("kickvane-" + name + "-" +
            std::to_string(::testing::UnitTest::GetInstance()->random_seed()) + ".png");
}

TEST(GalleryTest, RunSkinGallery_WritesASheetThatIsNotBlank_OrReportsAFileItCannotWrite) {
    const fs::path out = tempSheet("skin-gallery");
    std::ostringstream err;
    ASSERT_EQ(runSkinGallery(out, err), 0) << err.str();
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
    EXPECT_NE(runSkinGallery("/nonexistent-folder/sheet.png", unwritable), 0);
    EXPECT_NE(unwritable.str().find("không ghi được"), std::string::npos);
}

// Every painter in every state, and every picture, drawn exactly as in the reference sheet. A
// change to the painters that moves a single pixel fails here; when a change of the look is
// meant, render the sheet again with these fonts and replace the reference.
TEST(GalleryTest, Sheet_MatchesTheReferencePixelForPixel) {
    if (!qgetenv("FONTCONFIG_FILE").endsWith("gallery_fonts.conf")) {
        GTEST_SKIP() << "the sheet's captions need the fixed fonts that ctest sets";
    }
    const fs::path out = tempSheet("skin-gallery-compare");
    std::ostringstream err;
    ASSERT_EQ(runSkinGallery(out, err), 0) << err.str();
    const QImage actual =
        QImage(QString::fromStdString(out.string())).convertToFormat(QImage::Format_RGB32);
    const QImage expected =
        QImage(QStringLiteral(KICKVANE_GALLERY_REFERENCE)).convertToFormat(QImage::Format_RGB32);
    ASSERT_FALSE(expected.isNull()) << KICKVANE_GALLERY_REFERENCE;
    ASSERT_EQ(actual.size(), expected.size()) << "sheet kept in " << out;

    long long differing = 0;
    int top = actual.height(), bottom = -1, left = actual.width(), right = -1;
    for (int y = 0; y < actual.height(); ++y) {
        for (int x = 0; x < actual.width(); ++x) {
            if (actual.pixel(x, y) != expected.pixel(x, y)) {
                ++differing;
                top = std::min(top, y);
                bottom = std::max(bottom, y);
                left = std::min(left, x);
                right = std::max(right, x);
            }
        }
    }
    EXPECT_EQ(differing, 0) << "pixels differ within x " << left << ".." << right << ", y " << top
                            << ".." << bottom << "; sheet kept in " << out;
    if (differing == 0) {
        fs::remove(out);
    }
}

}  // namespace
}  // namespace kickvane::skin
