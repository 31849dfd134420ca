#pragma once

#include <QComboBox>
#include <QKeyEvent>
#include <QLabel>
#include <QPixmap>
#include <QWidget>
#include <utility>

// Small widgets of the main window: pictures that keep the last picture that could be loaded,
// and labels that report clicks.
namespace kickvane::shell {

// Loads a picture file into `pixmap`; a file that is missing or no readable picture leaves the
// previous picture and returns false.
bool loadPicture(QPixmap& pixmap, const QString& file);

// Whether a focused widget draws its focus frame: not while the focus came from a mouse click,
// as on Windows; from the first key press on, or when the keyboard brought the focus, it does.
class FocusCue {
public:
    void focusIn(Qt::FocusReason reason);
    // A key pressed in `widget`: the frame becomes due (the widget repaints when it just did).
    // True when the key activates the widget: Space or Enter.
    bool keyPressed(QWidget& widget, const QKeyEvent& event);
    bool shown(const QWidget& widget) const { return keyboard_ && widget.hasFocus(); }

private:
    bool keyboard_ = false;
};

// A label that reports a click, as the catalog labels do to open their preview. It takes the
// keyboard focus, shows it with a dotted frame, and Space or Enter click it.
class ClickableLabel final : public QLabel {
    Q_OBJECT
public:
    explicit ClickableLabel(const QString& text, QWidget* parent = nullptr);

signals:
    void clicked();
    void hovered();  // the pointer came over the label

protected:
    void mouseReleaseEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void enterEvent(QEnterEvent* event) override;

private:
    FocusCue focusCue_;
};

// The hotkey box: a name typed or chosen from its list. It reports a name only once the user has
// finished with it (Enter, the focus leaving, a choice from the list), never a text half typed
// ("F1" on the way to "F13"). It takes the focus by a click, Tab or its label's mnemonic, and the
// wheel turns it only while it has the focus, so that the pointer passing over it changes
// nothing.
class HotkeyBox final : public QComboBox {
    Q_OBJECT
public:
    explicit HotkeyBox(QWidget* parent);

signals:
    void nameChosen(const QString& name);

protected:
    void wheelEvent(QWheelEvent* event) override;
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

// A tab head: the skin's tab picture with the tab's name on it. It takes the keyboard focus,
// shows it with a frame over the picture, and Space or Enter choose its tab; the arrow keys
// move to the tab head above or below and choose that one.
class TabHead final : public PictureBox {
    Q_OBJECT
public:
    TabHead(const QString& caption, QWidget* parent);
    const QString& caption() const { return caption_; }

protected:
    void paintEvent(QPaintEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;

private:
    QString caption_;
    FocusCue focusCue_;
};

}  // namespace kickvane::shell
