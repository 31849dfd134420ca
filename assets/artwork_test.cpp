// Checks the artwork the build drew into the tool folder: every file the window and the engine load
// is there, at the size the window draws it, and looks like what it is meant to be.
#include <gtest/gtest.h>

#include <QFile>
#include <QImage>
#include <QSet>
#include <QString>
#include <QtEndian>

namespace {

const QString kTool = QStringLiteral(KICKVANE_TOOL_DIR);

QImage Load(const QString& relative) {
    return QImage(kTool + relative);
}

// Mean brightness in 0..1 of a rectangle of the image (the whole image when the rectangle is null).
double Brightness(const QImage& image, QRect area = {}) {
    if (area.isNull()) {
        area = image.rect();
    }
    double sum = 0;
    for (int y = area.top(); y <= area.bottom(); ++y) {
        for (int x = area.left(); x <= area.right(); ++x) {
            sum += qGray(image.pixel(x, y));
        }
    }
    return sum / (255.0 * area.width() * area.height());
}

TEST(Artwork, SkinPicturesHaveTheSizesTheWindowDrawsThem) {
    for (const char* skin : {"skin1", "skin2"}) {
        const QString prefix = QStringLiteral("/skin/%1").arg(skin);
        EXPECT_EQ(Load(prefix + "_bg.jpg").size(), QSize(425, 478)) << skin;
        EXPECT_EQ(Load(prefix + "_panel.jpg").size(), QSize(321, 357)) << skin;
        EXPECT_EQ(Load(prefix + "_selected.jpg").size(), QSize(82, 31)) << skin;
        EXPECT_EQ(Load(prefix + "_unselect.jpg").size(), QSize(82, 31)) << skin;
    }
}

TEST(Artwork, SkinOneIsLightSkinTwoIsDarkAndTabHeadsSuitDarkCaptions) {
    const QRect body(0, 50, 425, 380);  // below the header strip
    EXPECT_GT(Brightness(Load("/skin/skin1_bg.jpg"), body), 0.75);
    EXPECT_GT(Brightness(Load("/skin/skin1_panel.jpg")), 0.75);
    EXPECT_LT(Brightness(Load("/skin/skin2_bg.jpg"), body), 0.3);
    EXPECT_LT(Brightness(Load("/skin/skin2_panel.jpg")), 0.3);
    // The window writes the tab captions in dark text in both skins.
    const QRect middle(20, 8, 42, 15);
    for (const char* tab :
         {"skin1_selected", "skin1_unselect", "skin2_selected", "skin2_unselect"}) {
        EXPECT_GT(Brightness(Load(QStringLiteral("/skin/%1.jpg").arg(tab)), middle), 0.55) << tab;
    }
}

TEST(Artwork, EveryLabelHasADistinctDrawnPreview) {
    const std::pair<int, int> tabs[] = {{1, 14}, {2, 4}, {3, 8}, {4, 11}};
    QSet<QByteArray> seen;
    for (const auto& [tab, count] : tabs) {
        for (int i = 0; i < count; ++i) {
            const QString name = QStringLiteral("/img/t%1_img_%2.jpg").arg(tab).arg(i);
            const QImage image = Load(name);
            ASSERT_EQ(image.size(), QSize(597, 397)) << name.toStdString();
            QSet<QRgb> colours;
            for (int y = 0; y < image.height(); y += 3) {
                for (int x = 0; x < image.width(); x += 3) {
                    colours.insert(image.pixel(x, y) & 0xF0F0F0);
                }
            }
            EXPECT_GT(colours.size(), 150) << name.toStdString() << " looks blank";
            QFile file(kTool + name);
            ASSERT_TRUE(file.open(QIODevice::ReadOnly));
            const QByteArray bytes = file.readAll();
            EXPECT_FALSE(seen.contains(bytes)) << name.toStdString() << " repeats another";
            seen.insert(bytes);
        }
    }
    EXPECT_FALSE(QFile::exists(kTool + "/img/t4_img_11.jpg"));
}

TEST(Artwork, IconsAreSquareWithTransparentCornersAndAnOpaqueCentre) {
    for (int size : {16, 32, 64}) {
        const QImage icon = Load(QStringLiteral("/icons/kickvane-%1.png").arg(size));
        ASSERT_EQ(icon.size(), QSize(size, size));
        EXPECT_EQ(qAlpha(icon.pixel(0, 0)), 0) << size;
        EXPECT_EQ(qAlpha(icon.pixel(size / 2, size / 2)), 255) << size;
    }
}

TEST(Artwork, SoundIsAShortPcmWaveThatStartsAndEndsInSilence) {
    QFile file(kTool + "/sound.wav");
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    const QByteArray wav = file.readAll();
    ASSERT_GT(wav.size(), 44);
    auto u16 = [&](int at) { return qFromLittleEndian<quint16>(wav.constData() + at); };
    auto u32 = [&](int at) { return qFromLittleEndian<quint32>(wav.constData() + at); };
    EXPECT_EQ(wav.mid(0, 4), "RIFF");
    EXPECT_EQ(u32(4), static_cast<quint32>(wav.size() - 8));
    EXPECT_EQ(wav.mid(8, 8), "WAVEfmt ");
    EXPECT_EQ(u16(20), 1);  // PCM
    EXPECT_EQ(u16(22), 1);  // mono
    EXPECT_EQ(u32(24), 44100u);
    EXPECT_EQ(u16(34), 16);
    EXPECT_EQ(wav.mid(36, 4), "data");
    ASSERT_EQ(u32(40), static_cast<quint32>(wav.size() - 44));

    const int samples = (wav.size() - 44) / 2;
    const double seconds = samples / 44100.0;
    EXPECT_GT(seconds, 0.2);
    EXPECT_LT(seconds, 1.0);
    auto sample = [&](int i) { return static_cast<qint16>(u16(44 + 2 * i)); };
    int peak = 0;
    for (int i = 0; i < samples; ++i) {
        peak = std::max(peak, std::abs(static_cast<int>(sample(i))));
    }
    EXPECT_GT(peak, 8000);   // audible
    EXPECT_LT(peak, 32767);  // not clipped
    EXPECT_LT(std::abs(sample(0)), 200);
    EXPECT_LT(std::abs(sample(samples - 1)), 200);
}

}  // namespace
