#pragma once

#include "platform/ado/rows.h"

#include <QAbstractItemModel>
#include <QHash>

/// The discs that a search has found, and below each its tracks, read when it is opened; or one
/// node that says what to do. There is no object per node.
class MatchTree : public QAbstractItemModel
{
    Q_OBJECT

public:
    static constexpr int keyRole = Qt::UserRole; // as matchkey makes them

    using QAbstractItemModel::QAbstractItemModel;

    void showText(const QString &text);
    void showDiscs(std::shared_ptr<const ADODB::Rows> discs, bool withTracks); // matchingDiscs()

    QModelIndex index(int row, int column, const QModelIndex &parent = {}) const override;
    QModelIndex parent(const QModelIndex &child) const override;
    int rowCount(const QModelIndex &parent = {}) const override;
    int columnCount(const QModelIndex & /*parent*/ = {}) const override { return 1; }
    bool hasChildren(const QModelIndex &parent = {}) const override;
    bool canFetchMore(const QModelIndex &parent) const override;
    void fetchMore(const QModelIndex &parent) override;
    QVariant data(const QModelIndex &index, int role) const override;

signals:
    void failed(const QString &why); // the tracks of a disc could not be read

private:
    bool isDisc(const QModelIndex &index) const { return index.internalId() == 0; }
    int discOf(const QModelIndex &track) const { return int(track.internalId()) - 1; }
    QString discKey(int disc) const;
    QString discText(int disc) const;
    QString trackText(int disc, int track) const;
    QString keyOf(const QModelIndex &index) const;

    QString mText;                                          // instead of discs
    std::shared_ptr<const ADODB::Rows> mDiscs;              // null: the text alone
    QHash<int, std::shared_ptr<const ADODB::Rows>> mTracks; // by disc, of those opened
    bool mWithTracks = false;
};
