#include "shell/side_window_set.h"

#include "shell/qt_text.h"

namespace kickvane::shell {

void SideWindowSet::show(QPointer<QWidget>& window, QWidget* (*create)(QWidget*)) {
    if (!window) {
        window = create(owner_);
    }
    window->show();
    window->raise();
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
    preview_->show();
    preview_->raise();
    return *preview_;
}

}  // namespace kickvane::shell
