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

}  // namespace
}  // namespace kickvane::skin
