#include "shell/outcome_view.h"

#include "shell/message_box.h"
#include "shell/qt_text.h"

namespace kickvane::shell {

void OutcomeView::Show(const session::Outcome& shown) {
    if (!shown.signalSound.empty() && sound_) {
        sound_(shown.signalSound);
    }
    for (const text::Message& message : shown.messages) {
        ShowMessage(message);
    }
    if (shown.popup) {
        ShowPopup(*shown.popup);
    }
}

void OutcomeView::ShowMessage(const text::Message& message) {
    const QString text = ToQString(message.text);
    const QString title = ToQString(message.title);
    switch (message.kind) {
        case text::Message::Kind::Component:
            dialogs_.ShowMessage(owner_, NoticeTitle(), text);
            break;
        case text::Message::Kind::Plain:
            dialogs_.ShowMessage(owner_, title, text);
            break;
        case text::Message::Kind::Warning:
            dialogs_.ShowMessage(owner_, title, text, Dialogs::Icon::Warning);
            break;
        case text::Message::Kind::Notice:
            dialogs_.ShowNotice(owner_, title, text);
            break;
    }
}

void OutcomeView::ShowPopup(const session::Popup& popup) {
    dialogs_.ShowPopup(ToQString(popup.text), popup.seconds);
}

}  // namespace kickvane::shell
