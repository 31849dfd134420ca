#include "skin/pictures.h"

#include <set>

#include <gtest/gtest.h>

namespace kickvane::skin {
namespace {

int countMagenta(const QImage& image, const QRect& area) {
    int count = 0;
    for (int y = area.top(); y <= area.bottom(); ++y) {
        for (int x = area.left(); x <= area.right(); ++x) {
            count += (image.pixel(x, y) & 0xFFFFFFu) == 0xFF00FFu ? 1 : 0;
        }
    }
    return count;
}

// One set for all tests: generating the pictures is the slow part.
const SkinPictures& thePictures() {
    static const SkinPictures pictures = makeSkinPictures();
    return pictures;
}

TEST(PicturesTest, EveryPictureHasItsSize_AndOnlyKeyedOnesUseMagenta) {
    std::set<std::string> names;
    for (const NamedPicture& picture : listPictures(thePictures())) {
        names.insert(picture.name);
        ASSERT_FALSE(picture.image->isNull()) << picture.name;
        EXPECT_EQ(picture.image->size(), QSize(picture.width, picture.height)) << picture.name;
        const int magenta = countMagenta(*picture.image, picture.image->rect());
        if (picture.keyed) {
            EXPECT_GT(magenta, 0) << picture.name;
        } else {
            EXPECT_EQ(magenta, 0) << picture.name << " is drawn without the key";
        }
    }
    EXPECT_EQ(names.size(), 32u);
}

TEST(PicturesTest, EveryArrowCellHoldsAGlyphOnTheKey) {
    const QImage& arrows = thePictures().arrows;
    for (int cell = 0; cell < 20; ++cell) {
        const int keyed = countMagenta(arrows, QRect(0, cell * 9, 9, 9));
        EXPECT_GT(keyed, 40) << cell;
        EXPECT_LT(keyed, 81 - 6) << cell;
    }
}

TEST(PicturesTest, KeyedThumbsKeepTheirPointInsideTheMarginsThatDoNotStretch) {
    // An upright thumb pointing down keeps its point in the bottom 10 rows, one pointing up in
    // the top 6; the middle rows between them are a plain body with no keyed pixels inside.
    const QImage& down = thePictures().trackThumbDown;
    const QImage& up = thePictures().trackThumbUp;
    for (int frame = 0; frame < 3; ++frame) {
        const int top = frame * 21;
        EXPECT_EQ(countMagenta(down, QRect(1, top + 6, 9, 5)), 0);
        EXPECT_GT(countMagenta(down, QRect(0, top + 11, 11, 10)), 0);
        EXPECT_EQ(countMagenta(up, QRect(1, top + 6, 9, 5)), 0);
        EXPECT_GT(countMagenta(up, QRect(0, top, 11, 6)), 0);
    }
    const QImage& left = thePictures().trackThumbLeft;
    EXPECT_EQ(countMagenta(left, QRect(6, 1, 5, 9)), 0);
    EXPECT_GT(countMagenta(left, QRect(0, 0, 6, 11)), 0);
}

}  // namespace
}  // namespace kickvane::skin
