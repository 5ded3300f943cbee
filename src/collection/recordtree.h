#pragma once

#include <QHash>
#include <QTreeWidget>
#include <vector>

/// The collection seen from the artists: letters, below them artists, their tracks, and the discs
/// on which a track stands. Filled level by level as nodes are opened; a closed node holds a
/// placeholder, so that it can be opened. Nodes are told apart by their keys: a letter (or the word
/// for all others), "A" and the id of an artist, "T" and that of a track, "C" and that of a row of
/// a disc.
class RecordTree : public QTreeWidget
{
    Q_OBJECT

public:
    explicit RecordTree(QWidget *parent = nullptr);

    /// Back to the 27 closed roots.
    void resetRoots();

    enum Level { Letter, Artist, Track, Disc };
    struct Node {
        QString key;
        QString text;
    };

    /// Puts nodes of a level under the node of this key, all at once, each with its placeholder.
    /// A key that another node has already is left out: in a damaged catalogue an id may stand
    /// twice.
    void addNodes(const QString &parentKey, Level level, const std::vector<Node> &nodes);
    void removeNode(const QString &key);

    QTreeWidgetItem *node(const QString &key) const { return mNodes.value(key); }
    static QString keyOf(const QTreeWidgetItem *node);

signals:
    void NodeClick(const QString &key); // by mouse, or by Enter
    void Expand(const QString &key);

protected:
    void focusInEvent(QFocusEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    QTreeWidgetItem *make(Level level, const Node &node);
    void putPlaceholder(QTreeWidgetItem *item, Level level, const Node &node);

    QHash<QString, QTreeWidgetItem *> mNodes;
};
