// The floor of the window's budget: a Qt Widgets program with one window and one label, built
// against the same Qt. What the tool's window costs beyond this is its own.
#include <QApplication>
#include <QLabel>

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QLabel label(QStringLiteral("Kickvane"));
    label.setWindowTitle(QStringLiteral("kickvane-floor"));
    label.resize(480, 320);
    label.show();
    return QApplication::exec();
}
