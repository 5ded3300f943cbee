#include "collection/firststeps.h"

#include "services/frame.h"
#include "services/messages.h"

#include <QAction>
#include <QBuffer>

using namespace Qt::StringLiterals;

namespace
{

constexpr int pictureSize = 16;

QString pictureOf(const QAction &command)
{
    constexpr double sharp = 2; // on every screen
    QByteArray bytes;
    QBuffer file(&bytes);
    file.open(QIODevice::WriteOnly);
    command.icon().pixmap(QSize(pictureSize, pictureSize), sharp).save(&file, "PNG");
    const QString size = QString::number(pictureSize);
    return u"<img width="_s + size + u" height="_s + size +
           u" style=\"vertical-align: middle\" src=\"data:image/png;base64,"_s +
           QString::fromLatin1(bytes.toBase64()) + u"\">"_s;
}

QString lineOf(const FirstSteps::Step &step, const QAction &command)
{
    QString line = u"<p><a href=\""_s + command.objectName() + u"\">"_s + GetMessage(step.words) +
                   u"</a>&nbsp; ("_s + command.shortcut().toString(QKeySequence::NativeText);
    if (!command.icon().isNull())
        line += u", "_s + GetMessage("xStepButton") + pictureOf(command);
    return line + u")</p>"_s;
}

} // namespace

FirstSteps::FirstSteps(QWidget *parent) : QLabel(parent)
{
    setTextFormat(Qt::RichText);
    setTextInteractionFlags(Qt::LinksAccessibleByKeyboard | Qt::LinksAccessibleByMouse);
    setFocusPolicy(Qt::StrongFocus);
    setAlignment(Qt::AlignCenter);
    setMargin(pictureSize);
    hide();
    connect(this, &QLabel::linkActivated, this, [](const QString &name) {
        if (QAction *command = frameCommand(name))
            command->trigger();
    });
}

void FirstSteps::showFor(bool empty, const char *head, const std::vector<Step> &steps)
{
    QString text = u"<p><b>"_s + GetMessage(head) + u"</b></p>"_s;
    for (const Step &step : steps) {
        const QAction *command = frameCommand(QLatin1String(step.command));
        if (empty && command && command->isEnabled())
            text += lineOf(step, *command);
    }
    setText(text);
    setVisible(empty);
}
