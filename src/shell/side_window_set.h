#pragma once

#include <QPointer>
#include <filesystem>

#include "catalog/catalog.h"
#include "shell/side_windows.h"

namespace kickvane::shell {

// The side windows of the main window, each made on first use and then shown again: the
// information window, the help window and the one preview window that all labels share.
class SideWindowSet {
public:
    SideWindowSet(QWidget* owner, std::filesystem::path toolFolder)
        : owner_(owner), toolFolder_(std::move(toolFolder)) {}

    // The owner's widgets from this one down stay visible when a text window must open over the
    // owner (the command buttons along its bottom).
    void keepClearFrom(QWidget* topOfClearArea) { keepClear_ = topOfClearArea; }

    void showAbout() { show(about_, createAboutWindow); }
    void showHelp() { show(help_, createHelpWindow); }
    // Shows the label's preview picture; a label without one changes nothing.
    void showPreview(catalog::LabelArray labels, int index);
    // Shows the preview of a variant the player added, or the note that it has none.
    void showAddedPreview(catalog::GroupId group, std::string_view name);

    PreviewWindow* preview() const { return preview_; }

private:
    void show(QPointer<QWidget>& window, QWidget* (*create)(QWidget*));
    PreviewWindow& shownPreview();

    QWidget* owner_;
    QPointer<QWidget> keepClear_;
    std::filesystem::path toolFolder_;
    QPointer<QWidget> about_;
    QPointer<QWidget> help_;
    QPointer<PreviewWindow> preview_;
};

}  // namespace kickvane::shell
