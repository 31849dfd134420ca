#include "shell/outcome_view.h"

#include "shell/message_box.h"
#include "shell/qt_text.h"

namespace kickvane::shell {

void OutcomeView::show(const session::Outcome& shown) {
    if (!shown.signalSound.empty() && sound_) {
        sound_(shown.signalSound);
    }
    for (const text::Message& message : shown.messages) {
        showMessage(message);
    }
    if (shown.popup) {
        showPopup(*shown.popup);
    }
}

void OutcomeView::showMessage(const text::Message& message) {
    const QString text = toQString(message.text);
    const QString title = toQString(message.title);
    switch (message.kind) {
        case text::Message::Kind::Component:
            dialogs_.showMessage(owner_, noticeTitle(), text);
            break;
        case text::Message::Kind::Plain:
            dialogs_.showMessage(owner_, title, text);
            break;
        case text::Message::Kind::Warning:
            dialogs_.showMessage(owner_, title, text, Dialogs::Icon::Warning);
            break;
        case text::Message::Kind::Notice:
            dialogs_.showNotice(owner_, title, text);
            break;
    }
}

void OutcomeView::showPopup(const session::Popup& popup) {
    dialogs_.showPopup(toQString(popup.text), popup.seconds);
}

}  // namespace kickvane::shell
