#include <QApplication>
#include <QLabel>

using namespace Qt::StringLiterals;

// The least that a program with a window can be: what the start of the program is held against.
int main(int argc, char **argv)
{
    const QApplication application(argc, argv);
    QLabel window(u"Empty window"_s);
    window.setAlignment(Qt::AlignCenter);
    window.resize(480, 300);
    window.show();
    return QApplication::exec();
}
