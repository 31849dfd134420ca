#pragma once

#include <QLabel>
#include <QPixmap>
#include <QWidget>

// Small widgets of the main window: pictures that keep the last picture that could be loaded,
// and labels that report clicks.
namespace kickvane::shell {

// Loads a picture file into `pixmap`; a file that is missing or no readable picture leaves the
// previous picture and returns false.
bool LoadPicture(QPixmap& pixmap, const QString& file);

// A label that reports a click, as the catalog labels do to open their preview.
class ClickableLabel final : public QLabel {
    Q_OBJECT
public:
    using QLabel::QLabel;

signals:
    void clicked();

protected:
    void mouseReleaseEvent(QMouseEvent* event) override;
};

// A surface with a background colour and a picture drawn unscaled at its top-left corner.
class PictureBox : public QWidget {
    Q_OBJECT
public:
    using QWidget::QWidget;

    // Keeps the previous picture when the file cannot be loaded.
    bool setPictureFile(const QString& file);
    const QString& pictureFile() const { return pictureFile_; }
    void setBackground(const QColor& colour);
    QColor background() const { return background_; }

signals:
    void clicked();

protected:
    void paintEvent(QPaintEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;

private:
    QPixmap picture_;
    QString pictureFile_;
    QColor background_{0xE0, 0xE0, 0xE0};
};

// A tab head: the skin's tab picture with the tab's name on it.
class TabHead final : public PictureBox {
    Q_OBJECT
public:
    TabHead(const QString& caption, QWidget* parent);
    const QString& caption() const { return caption_; }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    QString caption_;
};

}  // namespace kickvane::shell
