// The static Qt for Windows links what the program needs: https through Schannel for the update
// host, and the JPEG and PNG readers for the skins and previews.
#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QImageReader>
#include <QSslSocket>

namespace {

TEST(QtForWindows, HasHttpsAndTheImageFormatsOfTheArtwork) {
    int argc = 1;
    char name[] = "qt_windows_tests";
    char* argv[] = {name, nullptr};
    QCoreApplication app(argc, argv);
    EXPECT_TRUE(QSslSocket::supportsSsl());
    EXPECT_EQ(QSslSocket::activeBackend(), QStringLiteral("schannel"));
    const QList<QByteArray> formats = QImageReader::supportedImageFormats();
    EXPECT_TRUE(formats.contains("jpeg"));
    EXPECT_TRUE(formats.contains("png"));
}

}  // namespace
