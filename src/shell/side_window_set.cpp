#include "shell/side_window_set.h"

#include <QScreen>

#include "shell/qt_text.h"

namespace kickvane::shell {

namespace {

// Brings a side window to the front with the keyboard focus, so that Escape closes it at once.
void showInFront(QWidget& window) {
    window.show();
    window.raise();
    window.activateWindow();
}

}  // namespace

void SideWindowSet::show(QPointer<QWidget>& window, QWidget* (*create)(QWidget*)) {
    if (!window) {
        window = create(owner_);
        window->adjustSize();
        // The owner's frame around the side window too, as the window manager will draw it.
        const QRect frame = owner_->frameGeometry();
        const QRect inner = owner_->geometry();
        const QMargins margins(inner.left() - frame.left(), inner.top() - frame.top(),
                               frame.right() - inner.right(), frame.bottom() - inner.bottom());
        const int clearTop =
            keepClear_ ? keepClear_->mapToGlobal(QPoint(0, 0)).y() : frame.bottom() + 1;
        const QScreen* screen = owner_->screen();
        const QRect area = screen ? screen->availableGeometry() : frame;
        const QPoint at =
            sideWindowPosition(area, frame, clearTop, window->size().grownBy(margins));
        window->move(at);
    }
    showInFront(*window);
}

void SideWindowSet::showPreview(catalog::LabelArray labels, int index) {
    const std::filesystem::path picture = previewPicture(toolFolder_, labels, index);
    if (picture.empty()) {
        return;
    }
    shownPreview().showPicture(picture);
}

void SideWindowSet::showAddedPreview(catalog::GroupId group, std::string_view name) {
    const std::filesystem::path picture = addedPreviewPicture(toolFolder_, group, name);
    PreviewWindow& window = shownPreview();
    if (picture.empty()) {
        window.showNoPicture();
        return;
    }
    window.showPicture(picture);
    if (window.pictureFile() != pathToQString(picture)) {
        window.showNoPicture();  // there but unreadable: never another entry's picture
    }
}

PreviewWindow& SideWindowSet::shownPreview() {
    if (!preview_) {
        preview_ = new PreviewWindow(owner_);
    }
    showInFront(*preview_);
    preview_->setFocus(Qt::OtherFocusReason);
    return *preview_;
}

}  // namespace kickvane::shell
