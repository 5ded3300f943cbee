#include <QApplication>
#include <QLabel>

// The least that a program with a window can be: what the start of the program is held against.
int main(int argc, char **argv)
{
    const QApplication application(argc, argv);
    QLabel window(QStringLiteral("Empty window"));
    window.setAlignment(Qt::AlignCenter);
    window.resize(480, 300);
    window.show();
    return QApplication::exec();
}
