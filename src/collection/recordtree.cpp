#include "collection/recordtree.h"

#include "shell/services/messages.h"

#include <QIcon>

namespace
{

constexpr int keyRole = Qt::UserRole;

QIcon icon(const char *name)
{
    return QIcon(QStringLiteral(":/icons/") + QLatin1String(name) + QStringLiteral(".svg"));
}

} // namespace

RecordTree::RecordTree(QWidget *parent) : QTreeWidget(parent)
{
    setHeaderHidden(true);
    setUniformRowHeights(true);
    setIconSize({18, 18});
}

QString RecordTree::keyOf(const QTreeWidgetItem *node)
{
    return node->data(0, keyRole).toString();
}

void RecordTree::resetRoots()
{
    clear();
    for (char letter = 'A'; letter <= 'Z'; ++letter)
        addRoot(QString(QLatin1Char(letter)));
    addRoot(GetMessage("Overige"));
}

QTreeWidgetItem *RecordTree::addRoot(const QString &name)
{
    static const QIcon letter = icon("letter");
    auto *root = new QTreeWidgetItem(this, {name});
    root->setData(0, keyRole, name);
    root->setIcon(0, letter);
    return root;
}
