#include "platform/desktop/options.h"

#include <QRadioButton>

void chooseOption(QRadioButton *option)
{
    option->setChecked(true);
    for (QRadioButton *other : option->parentWidget()->findChildren<QRadioButton *>())
        other->setFocusPolicy(other == option ? Qt::StrongFocus : Qt::ClickFocus);
}
