#pragma once

#include <QLabel>
#include <QWidget>
#include <filesystem>
#include <string_view>

#include "catalog/catalog.h"

// The small windows beside the main window: the preview picture of an entry, the information
// window and the help window.
namespace kickvane::shell {

// The preview picture of a catalog label: "img\t<tab>_img_<index>.jpg" in the tool folder, or
// an empty path for a label that has no preview.
std::filesystem::path previewPicture(const std::filesystem::path& toolFolder,
                                     catalog::LabelArray labels, int index);

// The preview picture of a variant the player added: "preview.jpg", else "preview.png", in its
// folder (any letter case); empty when it has neither.
std::filesystem::path addedPreviewPicture(const std::filesystem::path& toolFolder,
                                          catalog::GroupId group, std::string_view name);

// "Xem trước": one picture scaled to the window, which opens centred on the main window's
// screen. A picture that cannot be loaded leaves the one shown before (or a short note when there
// was none).
class PreviewWindow final : public QWidget {
    Q_OBJECT
public:
    explicit PreviewWindow(QWidget* owner);
    void showPicture(const std::filesystem::path& file);
    // The note that the entry has no preview picture, in place of any picture shown before.
    void showNoPicture();
    const QString& pictureFile() const { return pictureFile_; }

protected:
    void keyPressEvent(QKeyEvent* event) override;  // Escape closes it

private:
    QLabel* picture_;
    QString pictureFile_;
};

// Where a side window opens, as the top left corner of its frame of `size`: beside the owner's
// frame on the right, else on the left, when it fits in the work area `area`; otherwise centred
// over the owner, its bottom above `keepClearTop` (the top of the owner's command buttons) when
// there is room. Always inside the work area as far as the window's size allows.
QPoint sideWindowPosition(const QRect& area, const QRect& ownerFrame, int keepClearTop,
                          const QSize& size);

// "Thông tin": the tool's name and version. It and the help window close with their button
// "Đóng" or with Escape.
QWidget* createAboutWindow(QWidget* owner);

// "Hướng dẫn": the user guide.
QWidget* createHelpWindow(QWidget* owner);
QString helpText();

}  // namespace kickvane::shell
