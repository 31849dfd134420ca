#include "skin/pointer_probe.h"

#include <QCoreApplication>
#include <QCursor>
#include <QGuiApplication>
#include <QWindow>

namespace kickvane::skin {
namespace {

// The visible child window of `window` under the global point, searched depth first; the last
// child is the topmost.
QWindow* deepestAt(QWindow* window, const QPoint& global) {
    const QObjectList& children = window->children();
    for (auto it = children.rbegin(); it != children.rend(); ++it) {
        auto* child = qobject_cast<QWindow*>(*it);
        if (child == nullptr || !child->isVisible()) {
            continue;
        }
        const QRect area(child->mapToGlobal(QPoint(0, 0)), child->size());
        if (area.contains(global)) {
            return deepestAt(child, global);
        }
    }
    return window;
}

}  // namespace

std::optional<WindowHandle> QtPointerProbe::windowAtCursor() const {
    // Reading the cursor needs a running application.
    if (qobject_cast<QGuiApplication*>(QCoreApplication::instance()) == nullptr) {
        return std::nullopt;
    }
    const QPoint global = QCursor::pos();
    QWindow* top = QGuiApplication::topLevelAt(global);
    return top != nullptr ? static_cast<WindowHandle>(deepestAt(top, global)->winId()) : 0;
}

}  // namespace kickvane::skin
