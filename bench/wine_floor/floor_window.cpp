// One window with one label: what any Qt Widgets program of this Qt costs to start and keep.
#include <QApplication>
#include <QLabel>

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QLabel label(QStringLiteral("Kickvane floor"));
    label.setWindowTitle(QStringLiteral("Kickvane floor"));
    label.resize(320, 120);
    label.show();
    return QApplication::exec();
}
