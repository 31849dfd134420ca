#pragma once

#include <QElapsedTimer>
#include <QTimer>
#include <QWidget>

#include "popup/popup_model.h"

namespace kickvane::shell {

// The corner popup: a frameless window that never takes the focus and follows its model, which
// decides where it is, what it shows and when it goes. It deletes itself when the model finishes.
class AlertPopup final : public QWidget {
    Q_OBJECT
public:
    explicit AlertPopup(popup::PopupEnvironment environment);

    // Opens a popup the way the tool's callers do: timed, sliding, fitted, square frame.
    static AlertPopup* open(const QString& text, int displaySeconds);

    void displayMessage(const QString& text, int displaySeconds,
                        const popup::PopupStyle& style = {});

    const popup::AlertPopupModel& model() const { return model_; }
    // One tick of the motion; the timer calls it, tests may too.
    void tick();

    // The screen and text measures the model needs, from the primary screen and the popup font.
    static popup::PopupEnvironment screenEnvironment();

signals:
    // The player clicked the popup (it leaves then, unless it ignores clicks).
    void clicked();

protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;

private:
    void follow();
    // Runs the ticks that are due by the clock, so the popup's life does not depend on how
    // exactly the system timer fires.
    void catchUp();

    popup::AlertPopupModel model_;
    QTimer timer_;
    QElapsedTimer clock_;
    qint64 ticksRun_ = 0;
};

}  // namespace kickvane::shell
