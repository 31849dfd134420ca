// Global key state on X11. The sampler keeps its own connection to the X server and listens to
// XInput2 raw key events on the root window: the server sends these to every client that asks,
// also while another program holds a keyboard grab (since XInput 2.1), and listening takes no key
// away from the program that has the focus. Nothing is grabbed.
//
// There is no thread: each sample drains the queued events, so a press that went down and up
// between two samples is still seen, and asks the server for the keyboard map only while the key
// looks held. The connection's descriptor becomes readable when an event arrives: an event loop
// samples then, and needs a timer only while the key is held.
#include "platform/keystate.h"

#include <X11/Xlib.h>
#include <X11/extensions/XInput2.h>
#include <X11/keysym.h>

#include <array>

namespace kickvane::platform {

namespace {

// Catches the X errors of the requests made while it lives instead of letting Xlib's default
// handler end the process. The handler is process-wide, so the previous one comes back at the end.
class ScopedXErrorTrap {
public:
    explicit ScopedXErrorTrap(Display* display) : display_(display) {
        XSync(display_, False);
        failed_ = false;
        previous_ = XSetErrorHandler(&ScopedXErrorTrap::Record);
    }
    ScopedXErrorTrap(const ScopedXErrorTrap&) = delete;
    ScopedXErrorTrap& operator=(const ScopedXErrorTrap&) = delete;
    ~ScopedXErrorTrap() { XSetErrorHandler(previous_); }

    // Waits until the server has handled every request so far; true when one of them failed.
    bool Failed() {
        XSync(display_, False);
        return failed_;
    }

private:
    static int Record(Display*, XErrorEvent*) {
        failed_ = true;
        return 0;
    }

    static inline bool failed_ = false;
    Display* display_;
    XErrorHandler previous_ = nullptr;
};

// Asks for raw key events of all master keyboards on the root window. False when the server has
// no XInput 2.1 or refuses the selection.
bool SelectRawKeyEvents(Display* display, int* opcode) {
    int event = 0;
    int error = 0;
    if (!XQueryExtension(display, "XInputExtension", opcode, &event, &error)) {
        return false;
    }
    // Announces 2.2; the server answers with what it has. Raw events during grabs need 2.1.
    int major = 2;
    int minor = 2;
    if (XIQueryVersion(display, &major, &minor) != Success) {
        return false;
    }
    if (major < 2 || (major == 2 && minor < 1)) {
        return false;
    }

    std::array<unsigned char, XIMaskLen(XI_LASTEVENT)> bits{};
    XISetMask(bits.data(), XI_RawKeyPress);
    XISetMask(bits.data(), XI_RawKeyRelease);
    XIEventMask mask{};
    mask.deviceid = XIAllMasterDevices;
    mask.mask_len = static_cast<int>(bits.size());
    mask.mask = bits.data();

    ScopedXErrorTrap trap(display);
    XISelectEvents(display, DefaultRootWindow(display), &mask, 1);
    return !trap.Failed();
}

class X11KeySampler final : public KeySampler {
public:
    // `opcode` is the XInput extension's major opcode; -1 when raw events are not available, in
    // which case only the key's current state is reported.
    X11KeySampler(Display* display, int opcode) : display_(display), opcode_(opcode) {}
    X11KeySampler(const X11KeySampler&) = delete;
    X11KeySampler& operator=(const X11KeySampler&) = delete;
    ~X11KeySampler() override { XCloseDisplay(display_); }

    // With raw events every press and release arrives on the connection; without them the state
    // must be polled.
    int WakeDescriptor() const override { return opcode_ < 0 ? -1 : ConnectionNumber(display_); }

    KeySample Sample(int virtualKey) override {
        if (virtualKey < kVirtualKeyF1 || virtualKey > kVirtualKeyF12) {
            return {};
        }
        const KeySym keysym = XK_F1 + static_cast<KeySym>(virtualKey - kVirtualKeyF1);
        const KeyCode keycode = XKeysymToKeycode(display_, keysym);
        if (keycode == 0) {
            return {};  // The keyboard map has no such key.
        }

        DrainEvents();
        // Raw presses and releases keep the key's state without asking the server, so an idle
        // tick costs no round trip. The server is asked only when the key looks held (to be sure
        // a release was not missed) or when there are no raw events.
        if (opcode_ < 0 || down_[keycode]) {
            std::array<char, 32> keymap{};
            XQueryKeymap(display_, keymap.data());
            DrainEvents();
            const auto byte = static_cast<unsigned char>(keymap[keycode / 8]);
            down_[keycode] = (byte & (1u << (keycode % 8))) != 0;
        }

        KeySample sample;
        sample.down = down_[keycode];
        sample.pressedSinceLast = pressed_[keycode];
        pressed_[keycode] = false;
        return sample;
    }

private:
    // Reads every event that has arrived, without waiting, and notes the keys that went down or up.
    void DrainEvents() {
        while (XPending(display_) > 0) {
            XEvent event;
            XNextEvent(display_, &event);
            XGenericEventCookie* cookie = &event.xcookie;
            if (cookie->type != GenericEvent || cookie->extension != opcode_ ||
                !XGetEventData(display_, cookie)) {
                continue;
            }
            const auto* raw = static_cast<const XIRawEvent*>(cookie->data);
            if (raw->detail >= 0 && raw->detail < static_cast<int>(pressed_.size())) {
                const auto keycode = static_cast<size_t>(raw->detail);
                if (cookie->evtype == XI_RawKeyPress) {
                    pressed_[keycode] = true;
                    down_[keycode] = true;
                } else if (cookie->evtype == XI_RawKeyRelease) {
                    down_[keycode] = false;
                }
            }
            XFreeEventData(display_, cookie);
        }
    }

    Display* display_;
    int opcode_;
    std::array<bool, 256> pressed_{};  // per keycode: went down since its last sample
    std::array<bool, 256> down_{};     // per keycode: held, as the raw events tell
};

}  // namespace

std::unique_ptr<KeySampler> CreateKeySampler() {
    Display* display = XOpenDisplay(nullptr);
    if (display == nullptr) {
        return nullptr;  // No X server: a Wayland session without Xwayland, or a console.
    }
    int opcode = -1;
    if (!SelectRawKeyEvents(display, &opcode)) {
        opcode = -1;  // An old server: the current state alone still catches a held key.
    }
    return std::make_unique<X11KeySampler>(display, opcode);
}

}  // namespace kickvane::platform
