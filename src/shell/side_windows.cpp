#include "shell/side_windows.h"

#include <QPixmap>
#include <QVBoxLayout>

#include "platform/filesystem.h"

namespace kickvane::shell {

namespace {

constexpr QSize kPreviewSize(597, 397);

QWidget* TextWindow(QWidget* owner, const QString& title, const QStringList& paragraphs) {
    auto* window = new QWidget(owner, Qt::Tool);
    window->setAttribute(Qt::WA_DeleteOnClose);
    window->setWindowTitle(title);
    auto* layout = new QVBoxLayout(window);
    layout->setContentsMargins(16, 14, 16, 14);
    layout->setSpacing(10);
    for (const QString& paragraph : paragraphs) {
        auto* label = new QLabel(paragraph, window);
        label->setWordWrap(true);
        label->setTextInteractionFlags(Qt::TextSelectableByMouse);
        layout->addWidget(label);
    }
    window->setFixedWidth(420);
    return window;
}

}  // namespace

std::filesystem::path PreviewPicture(const std::filesystem::path& toolFolder,
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
    setWindowTitle(QStringLiteral("Xem truoc"));
    setFixedSize(kPreviewSize);
    picture_->setGeometry(0, 0, kPreviewSize.width(), kPreviewSize.height());
    picture_->setAlignment(Qt::AlignCenter);
    picture_->setScaledContents(true);
}

void PreviewWindow::ShowPicture(const std::filesystem::path& file) {
    QPixmap pixmap;
    const QString name = QString::fromStdString(file.string());
    if (pixmap.load(name)) {
        picture_->setScaledContents(true);
        picture_->setPixmap(pixmap);
        pictureFile_ = name;
    } else if (pictureFile_.isEmpty()) {
        picture_->setScaledContents(false);
        picture_->setText(QStringLiteral("Chưa có ảnh xem trước cho mục này."));
    }
}

QWidget* CreateAboutWindow(QWidget* owner) {
    return TextWindow(
        owner, QStringLiteral("Thong tin"),
        {QStringLiteral("<b>Kickvane</b> phiên bản 2.0"),
         QStringLiteral("Công cụ thay đổi đồ hoạ cho FIFA Online 2: bóng, mặt cỏ, biển quảng cáo, "
                        "bảng tỉ số, Mark, ngoại hình, giày, áo đấu, lưới, cổ động viên và sân "
                        "vận động."),
         QStringLiteral("Từ phiên bản 1.1 đến 2.0: thêm nạp nhanh Face và Ball, hai giao diện, ảnh "
                        "xem trước cho từng mục, kiểm tra phiên bản mới và biểu tượng ở khay hệ "
                        "thống.")});
}

QString HelpText() {
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
    }
        .join(QStringLiteral("\r\n"));
}

QWidget* CreateHelpWindow(QWidget* owner) {
    auto* window = TextWindow(owner, QStringLiteral("Huong dan"), {});
    auto* label = new QLabel(window);
    label->setTextFormat(Qt::PlainText);
    label->setText(HelpText().replace(QStringLiteral("\r\n"), QStringLiteral("\n")));
    label->setWordWrap(true);
    window->layout()->addWidget(label);
    window->setFixedWidth(520);
    return window;
}

}  // namespace kickvane::shell
