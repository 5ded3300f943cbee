#include "collection/recordtree.h"

#include "controls/list/accessiblecells.h"
#include "services/messages.h"

#include <QAccessible>
#include <QGuiApplication>
#include <QIcon>
#include <QKeyEvent>
#include <QPainter>
#include <QPalette>

using namespace Qt::StringLiterals;

namespace
{

/// Keys by the thousand: a plain member takes less than data of the model would.
class Item : public QTreeWidgetItem
{
public:
    Item(const QString &key, const QString &text) : QTreeWidgetItem(QStringList(text)), key(key) {}
    const QString key;
};

enum class OnSelection { Same, Silhouette };

// Of pictures in several sizes: what was drawn from a file of shapes would be tinted by the style
// on a selected node, and a blue note on blue is none.
QIcon icon(const char *name, OnSelection onSelection)
{
    const QIcon drawn(u":/icons/"_s + QLatin1String(name) + u".svg"_s);
    QIcon icon;
    for (const int size : {16, 24, 32, 48, 64}) {
        QPixmap picture = drawn.pixmap(QSize(size, size), 1.0);
        icon.addPixmap(picture);
        if (onSelection == OnSelection::Silhouette) {
            QPainter painter(&picture);
            painter.setCompositionMode(QPainter::CompositionMode_SourceIn);
            painter.fillRect(picture.rect(), QGuiApplication::palette().highlightedText());
        }
        icon.addPixmap(picture, QIcon::Selected);
    }
    return icon;
}

const QIcon &iconOf(RecordTree::Level level)
{
    static const QIcon icons[] = {
        icon("letter", OnSelection::Same), icon("artist", OnSelection::Silhouette),
        icon("track", OnSelection::Silhouette), icon("disc", OnSelection::Same)};
    return icons[level];
}

} // namespace

RecordTree::RecordTree(QWidget *parent) : QTreeWidget(parent)
{
    setHeaderHidden(true);
    setUniformRowHeights(true);
    setIconSize({18, 18});
    const auto keyed = [this](auto signal) {
        return [this, signal](QTreeWidgetItem *item) { emit(this->*signal)(keyOf(item)); };
    };
    for (auto changed : {&QTreeView::expanded, &QTreeView::collapsed})
        connect(this, changed, this, [this](const QModelIndex &node) { tellExpanded(this, node); });
    connect(this, &QTreeWidget::itemExpanded, this, keyed(&RecordTree::Expand));
    connect(this, &QTreeWidget::itemClicked, this, keyed(&RecordTree::NodeClick));
}

QString RecordTree::keyOf(const QTreeWidgetItem *node)
{
    return static_cast<const Item *>(node)->key;
}

void RecordTree::resetRoots()
{
    clear();
    mNodes.clear();
    QList<QTreeWidgetItem *> roots;
    for (char letter = 'A'; letter <= 'Z'; ++letter) {
        const QString name(QLatin1Char{letter});
        roots.append(make(Letter, {name, name}));
    }
    roots.append(make(Letter, {GetMessage("Overige"), GetMessage("Overige")}));
    addTopLevelItems(roots);
}

void RecordTree::addNodes(const QString &parentKey, Level level, const std::vector<Node> &nodes)
{
    QTreeWidgetItem *parent = node(parentKey);
    if (!parent)
        return;
    QList<QTreeWidgetItem *> items;
    items.reserve(qsizetype(nodes.size()));
    for (const Node &node : nodes) {
        if (!mNodes.contains(node.key))
            items.append(make(level, node));
    }
    parent->addChildren(items);
}

void RecordTree::removeNode(const QString &key)
{
    delete mNodes.take(key);
}

QTreeWidgetItem *RecordTree::make(Level level, const Node &node)
{
    auto *item = new Item(node.key, node.text);
    item->setIcon(0, iconOf(level));
    mNodes.insert(node.key, item);
    if (level != Disc)
        putPlaceholder(item, level, node);
    return item;
}

void RecordTree::putPlaceholder(QTreeWidgetItem *item, Level level, const Node &node)
{
    const Node below[] = {{u"dummyArtist"_s + node.key, u"dummy"_s + node.text},
                          {u"dummyT"_s + node.key, u"dummyTrack"_s},
                          {u"dummyC"_s + node.key, u"dummyCD"_s}};
    auto *placeholder = new Item(below[level].key, below[level].text);
    mNodes.insert(below[level].key, placeholder);
    item->addChild(placeholder);
}

void RecordTree::focusInEvent(QFocusEvent *event)
{
    QTreeWidget::focusInEvent(event);
    // The toolkit tells of the tree behind this.
    if (QAccessible::isActive())
        QMetaObject::invokeMethod(
            this, [this] { tellCurrentRow(this); }, Qt::QueuedConnection);
}

void RecordTree::keyPressEvent(QKeyEvent *event)
{
    const bool enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (enter && currentItem())
        emit NodeClick(keyOf(currentItem()));
    else
        QTreeWidget::keyPressEvent(event);
}
