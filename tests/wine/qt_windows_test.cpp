// The static Qt for Windows links what the program needs: https through Schannel for the update
// host, and the JPEG and PNG readers for the skins and previews. One application on the Windows
// platform serves every test of this program, its fonts set up as the tool's are.
#include <gtest/gtest.h>

#include <QApplication>
#include <QImageReader>
#include <QSslSocket>
#include <memory>

#include "shell/run_window.h"

namespace {

class QtApplication : public ::testing::Environment {
public:
    void SetUp() override {
        app_ = std::make_unique<QApplication>(argc_, argv_);
        kickvane::shell::useReadableFonts();
    }
    void TearDown() override { app_.reset(); }

private:
    int argc_ = 1;
    char name_[20] = "qt_windows_tests";
    char* argv_[2] = {name_, nullptr};
    std::unique_ptr<QApplication> app_;
};

[[maybe_unused]] ::testing::Environment* const kQtApplication =
    ::testing::AddGlobalTestEnvironment(new QtApplication);

TEST(QtForWindows, HasHttpsAndTheImageFormatsOfTheArtwork) {
    EXPECT_TRUE(QSslSocket::supportsSsl());
    EXPECT_EQ(QSslSocket::activeBackend(), QStringLiteral("schannel"));
    const QList<QByteArray> formats = QImageReader::supportedImageFormats();
    EXPECT_TRUE(formats.contains("jpeg"));
    EXPECT_TRUE(formats.contains("png"));
}

}  // namespace
