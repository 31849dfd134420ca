#include "shell/alert_popup.h"

#include <QFontMetrics>
#include <QGuiApplication>
#include <QPainter>
#include <QPainterPath>
#include <QPalette>
#include <QScreen>
#include <chrono>

#include "shell/qt_text.h"

namespace kickvane::shell {

namespace {

QColor toQColor(popup::Colour colour, const QPalette& palette) {
    return colour.buttonFace ? palette.color(QPalette::Button) : QColor::fromRgb(colour.rgb);
}

QFont popupFont() {
    QFont font(toQString(popup::kPopupFontFamily));
    font.setPointSizeF(popup::kPopupFontPointSize);
    return font;
}

QString displayText(const std::string& text) {
    QString shown = toQString(text);
    shown.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    return shown;
}

}  // namespace

popup::PopupEnvironment AlertPopup::screenEnvironment() {
    popup::PopupEnvironment environment;
    if (QScreen* screen = QGuiApplication::primaryScreen()) {
        const QRect work = screen->availableGeometry();
        environment.screen.workAreaRightPx = work.x() + work.width();
        environment.screen.workAreaBottomPx = work.y() + work.height();
        environment.screen.screenHeightPx = screen->geometry().height();
        environment.screen.dotsPerInchX = screen->logicalDotsPerInchX();
        environment.screen.dotsPerInchY = screen->logicalDotsPerInchY();
    }
    environment.translucencySupported =
        QGuiApplication::platformName() != QLatin1String("offscreen");
    environment.labelHeight = [](int widthPx, std::string_view text) {
        const QFontMetrics metrics(popupFont());
        return metrics
            .boundingRect(QRect(0, 0, widthPx, 100000), Qt::TextWordWrap,
                          displayText(std::string(text)))
            .height();
    };
    return environment;
}

AlertPopup::AlertPopup(popup::PopupEnvironment environment)
    : QWidget(nullptr, Qt::Tool | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint |
                           Qt::WindowDoesNotAcceptFocus),
      model_(std::move(environment)) {
    setAttribute(Qt::WA_DeleteOnClose);
    setAttribute(Qt::WA_ShowWithoutActivating);
    setWindowTitle(toQString(popup::kPopupCaption));
    setFont(popupFont());
    timer_.setTimerType(Qt::PreciseTimer);
    timer_.setInterval(
        std::chrono::duration_cast<std::chrono::milliseconds>(popup::kPopupTickInterval));
    connect(&timer_, &QTimer::timeout, this, &AlertPopup::catchUp);
}

AlertPopup* AlertPopup::open(const QString& text, int displaySeconds) {
    auto* popup = new AlertPopup(screenEnvironment());
    popup->displayMessage(text, displaySeconds);
    return popup;
}

void AlertPopup::displayMessage(const QString& text, int displaySeconds,
                                const popup::PopupStyle& style) {
    model_.DisplayMessage(toUtf8(text), displaySeconds, style);
    if (const auto& shape = model_.Frame().windowShape) {
        QPainterPath path;
        path.addRoundedRect(
            QRectF(shape->left, shape->top, shape->right - shape->left, shape->bottom - shape->top),
            shape->ellipseWidth / 2.0, shape->ellipseHeight / 2.0);
        setMask(QRegion(path.toFillPolygon().toPolygon()));
    }
    follow();
    show();
    clock_.start();
    ticksRun_ = 0;
    timer_.start();
}

void AlertPopup::catchUp() {
    const qint64 due =
        clock_.nsecsElapsed() /
        std::chrono::duration_cast<std::chrono::nanoseconds>(popup::kPopupTickInterval).count();
    while (ticksRun_ < due && !model_.Finished()) {
        ++ticksRun_;
        tick();
    }
}

void AlertPopup::tick() {
    model_.Tick();
    if (model_.Finished()) {
        timer_.stop();
        close();
        return;
    }
    follow();
}

void AlertPopup::follow() {
    const popup::PixelRect rect = model_.WindowPixels();
    setGeometry(rect.left, rect.top, rect.width, rect.height);
    if (const auto alpha = model_.Alpha()) {
        setWindowOpacity(*alpha / 255.0);
    }
}

void AlertPopup::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.fillRect(rect(), toQColor(model_.Fill(), palette()));
    const popup::PopupFrame& frame = model_.Frame();
    for (const popup::RoundedRect& shape : frame.shapes) {
        painter.setPen(toQColor(shape.colour, palette()));
        painter.setBrush(Qt::NoBrush);
        painter.drawRoundedRect(
            QRect(QPoint(shape.left, shape.top), QPoint(shape.right, shape.bottom)),
            shape.ellipseWidth / 2.0, shape.ellipseHeight / 2.0);
    }
    for (const popup::FrameLine& line : frame.lines) {
        painter.setPen(toQColor(line.colour, palette()));
        painter.drawLine(line.x1, line.y1, line.x2, line.y2);
    }
    const popup::PixelRect label = model_.LabelPixels();
    painter.setPen(toQColor(popup::kPopupTextColour, palette()));
    painter.setFont(popupFont());
    painter.drawText(QRect(label.left, label.top, label.width, label.height),
                     Qt::TextWordWrap | Qt::AlignLeft | Qt::AlignTop, displayText(model_.Text()));
}

void AlertPopup::mousePressEvent(QMouseEvent*) {
    emit clicked();
    model_.Click();
}

}  // namespace kickvane::shell
