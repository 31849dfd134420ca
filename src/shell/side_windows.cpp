#include "shell/side_windows.h"

#include <QGuiApplication>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QPixmap>
#include <QPushButton>
#include <QScreen>
#include <QStyle>
#include <QVBoxLayout>
#include <algorithm>

#include "catalog/added_variants.h"
#include "platform/filesystem.h"
#include "shell/qt_text.h"

namespace kickvane::shell {

namespace {

constexpr QSize kPreviewSize(597, 397);

// The side windows close on a plain Escape, as dialogs do.
bool closesOnEscape(QWidget& window, const QKeyEvent& event) {
    if (event.key() != Qt::Key_Escape || event.modifiers() != Qt::NoModifier) {
        return false;
    }
    window.close();
    return true;
}

// A window of text beside the main window that the user reads and closes, with its button
// "Đóng" or with Escape.
class TextWindow final : public QWidget {
public:
    TextWindow(QWidget* owner, const QString& title, const QStringList& paragraphs,
               Qt::TextFormat format, int width)
        : QWidget(owner, Qt::Tool) {
        setAttribute(Qt::WA_DeleteOnClose);
        setWindowTitle(title);
        auto* layout = new QVBoxLayout(this);
        layout->setContentsMargins(16, 14, 16, 14);
        layout->setSpacing(10);
        for (const QString& paragraph : paragraphs) {
            auto* label = new QLabel(this);
            label->setTextFormat(format);
            label->setText(paragraph);
            label->setWordWrap(true);
            label->setTextInteractionFlags(Qt::TextSelectableByMouse);
            layout->addWidget(label);
        }
        auto* close = new QPushButton(QStringLiteral("Đóng"), this);
        close->setObjectName(QStringLiteral("close"));
        connect(close, &QPushButton::clicked, this, &QWidget::close);
        auto* buttons = new QHBoxLayout;
        buttons->addStretch();
        buttons->addWidget(close);
        layout->addLayout(buttons);
        setFixedWidth(width);
        // The keyboard starts on the button, so Space and Enter close too.
        close->setAutoDefault(true);
        close->setFocus();
    }

protected:
    void keyPressEvent(QKeyEvent* event) override {
        if (!closesOnEscape(*this, *event)) {
            QWidget::keyPressEvent(event);
        }
    }
};

}  // namespace

QPoint sideWindowPosition(const QRect& area, const QRect& ownerFrame, int keepClearTop,
                          const QSize& size) {
    constexpr int kGap = 8;
    const auto inside = [&](QPoint at) {
        // The top left corner wins over the bottom right one when the window is too large.
        at.setX(std::max(std::min(at.x(), area.right() + 1 - size.width()), area.left()));
        at.setY(std::max(std::min(at.y(), area.bottom() + 1 - size.height()), area.top()));
        return at;
    };
    const int top = inside(ownerFrame.topLeft()).y();
    for (const int x : {ownerFrame.right() + 1 + kGap, ownerFrame.left() - kGap - size.width()}) {
        const QRect beside(QPoint(x, top), size);
        if (area.contains(beside)) {
            return beside.topLeft();
        }
    }
    const int centredX = ownerFrame.center().x() - size.width() / 2;
    const int centredY = ownerFrame.center().y() - size.height() / 2;
    return inside(QPoint(centredX, std::min(centredY, keepClearTop - kGap - size.height())));
}

std::filesystem::path previewPicture(const std::filesystem::path& toolFolder,
                                     catalog::LabelArray labels, int index) {
    int tab = 0;
    int last = 0;
    switch (labels) {
        case catalog::LabelArray::Category:
            tab = 1;
            last = 13;
            break;
        case catalog::LabelArray::Ball:
            tab = 2;
            last = 3;
            break;
        case catalog::LabelArray::Scoreboard:
            tab = 3;
            last = 7;
            break;
        case catalog::LabelArray::Other:
            tab = 4;
            last = 10;
            break;
    }
    if (index < 0 || index > last) {
        return {};
    }
    return platform::ResolveCaseInsensitive(
        toolFolder / "img" /
        ("t" + std::to_string(tab) + "_img_" + std::to_string(index) + ".jpg"));
}

PreviewWindow::PreviewWindow(QWidget* owner)
    : QWidget(owner, Qt::Tool), picture_(new QLabel(this)) {
    setAttribute(Qt::WA_DeleteOnClose);
    setFocusPolicy(Qt::StrongFocus);  // so that Escape reaches it
    setWindowTitle(QStringLiteral("Xem trước"));
    setFixedSize(kPreviewSize);
    picture_->setGeometry(0, 0, kPreviewSize.width(), kPreviewSize.height());
    picture_->setAlignment(Qt::AlignCenter);
    picture_->setScaledContents(true);
    // Centred on the main window's screen, not wherever the window manager would put it.
    QScreen* screen = owner ? owner->screen() : QGuiApplication::primaryScreen();
    if (screen) {
        const QRect area = screen->availableGeometry();
        const QRect centred =
            QStyle::alignedRect(Qt::LeftToRight, Qt::AlignCenter, kPreviewSize, area);
        // On a screen smaller than the picture its top left corner stays on the screen.
        move(std::max(centred.left(), area.left()), std::max(centred.top(), area.top()));
    }
}

void PreviewWindow::keyPressEvent(QKeyEvent* event) {
    if (!closesOnEscape(*this, *event)) {
        QWidget::keyPressEvent(event);
    }
}

void PreviewWindow::showPicture(const std::filesystem::path& file) {
    QPixmap pixmap;
    const QString name = pathToQString(file);
    if (!file.empty() && pixmap.load(name)) {
        picture_->setScaledContents(true);
        picture_->setPixmap(pixmap);
        pictureFile_ = name;
    } else if (pictureFile_.isEmpty()) {
        showNoPicture();
    }
}

void PreviewWindow::showNoPicture() {
    picture_->setScaledContents(false);
    picture_->setText(QStringLiteral("Chưa có ảnh xem trước cho mục này."));
    pictureFile_.clear();
}

std::filesystem::path addedPreviewPicture(const std::filesystem::path& toolFolder,
                                          catalog::GroupId group, std::string_view name) {
    const std::filesystem::path folder = platform::ResolveCaseInsensitive(
        toolFolder / "extras" / platform::PathFromUtf8(catalog::GroupFolder(group)) /
        platform::PathFromUtf8(name));
    for (std::string_view file : {"preview.jpg", "preview.png"}) {
        if (auto found = platform::FindEntryIgnoringCase(folder, file);
            found && platform::IsRegularFile(*found)) {
            return *found;
        }
    }
    return {};
}

QWidget* createAboutWindow(QWidget* owner) {
    return new TextWindow(
        owner, QStringLiteral("Thông tin"),
        {QStringLiteral("<b>Kickvane</b> phiên bản 2.0"),
         QStringLiteral("Công cụ thay đổi đồ hoạ cho FIFA Online 2: bóng, mặt cỏ, biển quảng cáo, "
                        "bảng tỉ số, Mark, ngoại hình, giày, áo đấu, lưới, cổ động viên và sân "
                        "vận động."),
         QStringLiteral("Từ phiên bản 1.1 đến 2.0: thêm nạp nhanh Face và Ball, hai giao diện, ảnh "
                        "xem trước cho từng mục, kiểm tra phiên bản mới và biểu tượng ở khay hệ "
                        "thống.")},
        Qt::RichText, 420);
}

QString helpText() {
    return QStringList{
        QStringLiteral("Hướng dẫn sử dụng:"),
        QStringLiteral(" 1. Tại thẻ đầu tiên các bạn chọn đường dẫn cài FIFA ONLINE 2."),
        QStringLiteral(" 2. Sau đó lựa chọn những Patch nào bạn thấy cần thiết"),
        QStringLiteral("    Ấn vào tên Patch để xem Demo nhé."),
        QStringLiteral(
            " 3. Các bạn chuyển qua lần lượt các thẻ khác và chọn cho mình một loại ưng ý."),
        QStringLiteral(" 4. Ấn Lưu thiết lập để lưu lại cấu hình cho lần sử dụng tiếp theo."),
        QStringLiteral(" 5. Ấn vào Khởi động FIFA để chạy GameLoader.exe"),
        QStringLiteral(
            " 6. Tại màn hình đăng nhập, ấn nút F7, khi nào có âm thanh báo hiệu thì các "
            "bạn mới tiến hành đăng nhập."),
        QString(),
        QStringLiteral("Hướng dẫn sử dụng công cụ Nạp nhanh:"),
        QStringLiteral(" 1. Ấn vào nút Nạp nhanh"),
        QStringLiteral(" 2. Chọn thư mục chứa các file Face và Ball"),
        QStringLiteral(" 3. Báo Hoàn tất thì việc copy đã xong"),
        QStringLiteral(
            "Lưu ý: Để sử dụng được các file sau khi đã nạp nhanh, thì lựa chọn Bóng phải "
            "để ở mặc định"),
        QString(),
        QStringLiteral("Thêm bộ đồ hoạ mới:"),
        QStringLiteral(" 1. Trong thư mục extras của công cụ, mở thư mục của nhóm: Ball, "
                       "scoreboard, adboard, pitch hoặc Indicator."),
        QStringLiteral(" 2. Tạo một thư mục mang tên bộ mới, chép các file vào, sắp xếp giống "
                       "các bộ có sẵn của nhóm đó."),
        QStringLiteral(" 3. Nếu muốn, thêm ảnh xem trước preview.jpg hoặc preview.png."),
        QStringLiteral(" 4. Mở lại công cụ, hoặc ẩn xuống khay rồi hiện lại."),
    }
        .join(QStringLiteral("\r\n"));
}

QWidget* createHelpWindow(QWidget* owner) {
    return new TextWindow(owner, QStringLiteral("Hướng dẫn"),
                          {helpText().replace(QStringLiteral("\r\n"), QStringLiteral("\n"))},
                          Qt::PlainText, 520);
}

}  // namespace kickvane::shell
