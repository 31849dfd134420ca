#include "shell/widgets.h"

#include <QAccessible>
#include <QAccessibleWidget>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPainter>
#include <QPixmapCache>
#include <algorithm>

namespace kickvane::shell {

namespace {

bool isActivationKey(const QKeyEvent& event) {
    if ((event.modifiers() & ~Qt::KeypadModifier) != Qt::NoModifier) {
        return false;
    }
    return event.key() == Qt::Key_Space || event.key() == Qt::Key_Return ||
           event.key() == Qt::Key_Enter;
}

// A dotted frame over a light line, readable on the light and the dark skin alike.
void drawFocusFrame(QPainter& painter, const QRect& frame) {
    painter.setBrush(Qt::NoBrush);
    painter.setPen(QPen(QColor(255, 255, 255, 220), 1));
    painter.drawRect(frame);
    painter.setPen(QPen(QColor(0x10, 0x18, 0x20), 1, Qt::DotLine));
    painter.drawRect(frame);
}

// What assistive tools learn of a tab head or an entry label: its role, the text the user reads
// on it as its name, and a press action that clicks it.
class ClickableAccessible final : public QAccessibleWidget {
public:
    ClickableAccessible(QWidget* widget, QAccessible::Role role, QString (*name)(QWidget*),
                        void (*press)(QWidget*))
        : QAccessibleWidget(widget, role), name_(name), press_(press) {}

    QString text(QAccessible::Text kind) const override {
        if (kind == QAccessible::Name && widget()->accessibleName().isEmpty()) {
            return name_(widget());
        }
        return QAccessibleWidget::text(kind);
    }

    QStringList actionNames() const override {
        return QStringList{pressAction()} + QAccessibleWidget::actionNames();
    }

    void doAction(const QString& action) override {
        if (action == pressAction()) {
            press_(widget());
        } else {
            QAccessibleWidget::doAction(action);
        }
    }

private:
    QString (*name_)(QWidget*);
    void (*press_)(QWidget*);
};

QAccessibleInterface* accessibleFor(const QString&, QObject* object) {
    if (auto* tab = qobject_cast<TabHead*>(object)) {
        return new ClickableAccessible(
            tab, QAccessible::PageTab,
            [](QWidget* w) { return static_cast<TabHead*>(w)->caption(); },
            [](QWidget* w) { emit static_cast<TabHead*>(w)->clicked(); });
    }
    if (auto* label = qobject_cast<ClickableLabel*>(object)) {
        return new ClickableAccessible(
            label, QAccessible::Button,
            [](QWidget* w) { return static_cast<ClickableLabel*>(w)->text(); },
            [](QWidget* w) { emit static_cast<ClickableLabel*>(w)->clicked(); });
    }
    return nullptr;
}

void installAccessibility() {
    static const bool installed = [] {
        QAccessible::installFactory(&accessibleFor);
        return true;
    }();
    (void)installed;
}

}  // namespace

void FocusCue::focusIn(Qt::FocusReason reason) {
    // Coming back to the window keeps whatever the focus looked like before.
    if (reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason) {
        keyboard_ = reason != Qt::MouseFocusReason;
    }
}

bool FocusCue::keyPressed(QWidget& widget, const QKeyEvent& event) {
    if (!std::exchange(keyboard_, true)) {
        widget.update();
    }
    return isActivationKey(event);
}

bool loadPicture(QPixmap& pixmap, const QString& file) {
    // The same few skin pictures are drawn on every tab switch and by all four panels: decode
    // each file once and share it.
    QPixmap loaded;
    if (!QPixmapCache::find(file, &loaded)) {
        if (!loaded.load(file)) {
            return false;
        }
        QPixmapCache::insert(file, loaded);
    }
    pixmap = loaded;
    return true;
}

ClickableLabel::ClickableLabel(const QString& text, QWidget* parent) : QLabel(text, parent) {
    installAccessibility();
    setFocusPolicy(Qt::StrongFocus);
    setAccessibleDescription(QStringLiteral("Xem ảnh minh hoạ"));
}

void ClickableLabel::enterEvent(QEnterEvent* event) {
    QLabel::enterEvent(event);
    emit hovered();
}

void ClickableLabel::keyPressEvent(QKeyEvent* event) {
    if (focusCue_.keyPressed(*this, *event)) {
        emit clicked();
        return;
    }
    QLabel::keyPressEvent(event);
}

void ClickableLabel::focusInEvent(QFocusEvent* event) {
    focusCue_.focusIn(event->reason());
    QLabel::focusInEvent(event);
}

void ClickableLabel::paintEvent(QPaintEvent* event) {
    QLabel::paintEvent(event);
    if (focusCue_.shown(*this)) {
        QPainter painter(this);
        drawFocusFrame(painter, rect().adjusted(0, 0, -1, -1));
    }
}

void ClickableLabel::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint())) {
        emit clicked();
    }
    QLabel::mouseReleaseEvent(event);
}

HotkeyBox::HotkeyBox(QWidget* parent) : QComboBox(parent) {
    setEditable(true);
    setInsertPolicy(QComboBox::NoInsert);  // a typed name does not join the list
    // No completion: it would fill in a key the player did not type ("F" and Enter would take
    // "F1"). Names are then matched exactly, as the settings file's are.
    setCompleter(nullptr);
    setFocusPolicy(Qt::StrongFocus);
    connect(lineEdit(), &QLineEdit::editingFinished, this,
            [this] { emit nameChosen(currentText()); });
    connect(this, &QComboBox::textActivated, this, &HotkeyBox::nameChosen);
}

void HotkeyBox::wheelEvent(QWheelEvent* event) {
    if (hasFocus()) {
        QComboBox::wheelEvent(event);
    } else {
        event->ignore();  // the window under it gets the wheel
    }
}

bool PictureBox::setPictureFile(const QString& file) {
    if (!loadPicture(picture_, file)) {
        return false;
    }
    pictureFile_ = file;
    update();
    return true;
}

void PictureBox::setBackground(const QColor& colour) {
    background_ = colour;
    update();
}

void PictureBox::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.fillRect(rect(), background_);
    if (!picture_.isNull()) {
        painter.drawPixmap(0, 0, picture_);
    }
}

void PictureBox::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint())) {
        emit clicked();
    }
    QWidget::mouseReleaseEvent(event);
}

TabHead::TabHead(const QString& caption, QWidget* parent) : PictureBox(parent), caption_(caption) {
    installAccessibility();
    setCursor(Qt::PointingHandCursor);
    setFocusPolicy(Qt::StrongFocus);
}

void TabHead::keyPressEvent(QKeyEvent* event) {
    if (focusCue_.keyPressed(*this, *event)) {
        emit clicked();
        return;
    }
    // The tab heads stand in a column: their order on screen is their order for the arrows.
    QList<TabHead*> heads = parentWidget()
                                ? parentWidget()->findChildren<TabHead*>(Qt::FindDirectChildrenOnly)
                                : QList<TabHead*>{this};
    std::stable_sort(heads.begin(), heads.end(),
                     [](const TabHead* a, const TabHead* b) { return a->y() < b->y(); });
    const qsizetype at = heads.indexOf(this);
    qsizetype next = at;
    switch (event->key()) {
        case Qt::Key_Up:
        case Qt::Key_Left:
            next = std::max<qsizetype>(at - 1, 0);
            break;
        case Qt::Key_Down:
        case Qt::Key_Right:
            next = std::min<qsizetype>(at + 1, heads.size() - 1);
            break;
        default:
            PictureBox::keyPressEvent(event);
            return;
    }
    if (next != at) {
        TabHead* head = heads[next];
        head->setFocus(Qt::OtherFocusReason);
        emit head->clicked();
    }
}

void TabHead::focusInEvent(QFocusEvent* event) {
    focusCue_.focusIn(event->reason());
    PictureBox::focusInEvent(event);
}

void TabHead::paintEvent(QPaintEvent* event) {
    PictureBox::paintEvent(event);
    QPainter painter(this);
    QFont font = painter.font();
    font.setBold(true);
    painter.setFont(font);
    // The caption stays readable on light and dark tab pictures alike.
    painter.setPen(QColor(255, 255, 255, 200));
    painter.drawText(rect().translated(1, 1), Qt::AlignCenter, caption_);
    painter.setPen(QColor(0x20, 0x30, 0x40));
    painter.drawText(rect(), Qt::AlignCenter, caption_);
    if (focusCue_.shown(*this)) {
        drawFocusFrame(painter, rect().adjusted(2, 2, -3, -3));
    }
}

}  // namespace kickvane::shell
