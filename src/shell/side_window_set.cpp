#include "shell/side_window_set.h"

namespace kickvane::shell {

void SideWindowSet::show(QPointer<QWidget>& window, QWidget* (*create)(QWidget*)) {
    if (!window) {
        window = create(owner_);
    }
    window->show();
    window->raise();
}

void SideWindowSet::showPreview(catalog::LabelArray labels, int index) {
    const std::filesystem::path picture = PreviewPicture(toolFolder_, labels, index);
    if (picture.empty()) {
        return;
    }
    if (!preview_) {
        preview_ = new PreviewWindow(owner_);
    }
    preview_->show();
    preview_->raise();
    preview_->ShowPicture(picture);
}

}  // namespace kickvane::shell
