#include "controls/tracks/trackmodel.h"

#include "catalogue/typedtext.h"
#include "platform/text/textrules.h"

#include <QRegularExpression>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

// Quotes around a cell count only where they are needed, so that a title "Heroes" keeps its own.
QString takeCell(const QString &lines, qsizetype &at)
{
    static const QRegularExpression between(uR"re("([^"]*+(?:""[^"]*+)*+)"(?=[\t\n]|$))re"_s);
    static const QRegularExpression special(u"[\t\n]|\"\""_s);
    static const QRegularExpression end(u"[\t\n]"_s);
    const auto match = between.match(lines, at, QRegularExpression::NormalMatch,
                                     QRegularExpression::AnchorAtOffsetMatchOption);
    if (match.hasMatch() && match.captured(1).contains(special)) {
        at = match.capturedEnd();
        return match.captured(1).replace("\"\""_L1, "\""_L1);
    }
    const qsizetype from = std::exchange(at, lines.indexOf(end, at));
    if (at < 0)
        at = lines.size();
    return lines.sliced(from, at - from);
}

// As the cell of a table, whatever stands behind it.
bool readsAsItIs(const QString &cell)
{
    static const QRegularExpression plain(
        QRegularExpression::anchoredPattern(uR"re((?:[^"\t\r\n][^\t\r\n]*)?|"[^"\t\r\n]*")re"_s));
    return plain.match(cell).hasMatch();
}

QString inQuotes(QString cell)
{
    return u'"' + cell.replace("\""_L1, "\"\""_L1) + u'"';
}

bool beginWithNumbers(const QList<QStringList> &lines)
{
    bool more = false;
    for (const QStringList &line : lines) {
        const QString first = line.value(0).trimmed();
        if (!first.isEmpty() && !text::isNumeric(first))
            return false;
        more = more || line.size() > 1;
    }
    return more;
}

} // namespace

TrackModel::TrackModel(bool withArtist, QObject *parent)
    : QAbstractTableModel(parent), mFirstField(withArtist ? ArtistField : TitleField)
{
}

void TrackModel::setHeads(const QStringList &heads)
{
    mHeads = heads;
    emit headerDataChanged(Qt::Horizontal, 0, columnCount() - 1);
}

void TrackModel::load(const QList<StoredTrack> &tracks)
{
    QList<Row> rows;
    mSaved = mSavedBefore = {};
    for (const StoredTrack &track : tracks) {
        rows.append(Row{++mLastKey, track.texts});
        mSaved.order.append(mLastKey);
        mSaved.tracks.insert(mLastKey, track);
    }
    mUndo.clear();
    mRedo.clear();
    show(rows);
}

void TrackModel::showUnsaved(const QList<StoredTrack> &tracks)
{
    QHash<qint64, int> keys;
    for (auto saved = mSaved.tracks.cbegin(); saved != mSaved.tracks.cend(); ++saved)
        keys.insert(saved->linkId, saved.key());
    QList<Row> rows;
    for (const StoredTrack &track : tracks) {
        const int known = keys.take(track.linkId);
        rows.append(Row{known ? known : ++mLastKey, track.texts});
    }
    change(rows, 0, 1);
}

QString TrackModel::text(int row, TrackField field) const
{
    return row >= 0 && row < mRows.size() ? mRows[row].texts[field] : QString();
}

int TrackModel::trackNumber(int row) const
{
    return mNumbers.value(row);
}

QString TrackModel::keep(int row, TrackField field, const QString &typed) const
{
    return typedtext::keep(typed, text(row, field)).text;
}

void TrackModel::setText(int row, TrackField field, const QString &text)
{
    const QString kept = keep(row, field, text);
    if (kept == this->text(row, field))
        return;
    QList<Row> rows = mRows;
    fillUpTo(rows, row);
    rows[row].texts[field] = kept;
    change(rows, row, columnOf(field));
}

void TrackModel::clear(const QModelIndexList &cells)
{
    QList<Row> rows = mRows;
    QModelIndex cleared;
    for (const QModelIndex &cell : cells) {
        if (cell.column() == 0 || text(cell.row(), fieldOf(cell.column())).isEmpty())
            continue;
        rows[cell.row()].texts[fieldOf(cell.column())].clear();
        cleared = cell;
    }
    if (cleared.isValid())
        change(rows, cleared.row(), cleared.column());
}

void TrackModel::insertTrack(int row)
{
    if (mFixed || row < 0 || row >= waitingRow())
        return; // an empty row is there already
    QList<Row> rows = mRows;
    rows.insert(row, Row{++mLastKey, {}});
    change(rows, row, 1);
}

void TrackModel::removeTrack(int row)
{
    if (mFixed || row < 0 || row >= waitingRow())
        return;
    QList<Row> rows = mRows;
    rows.removeAt(row);
    change(rows, row, 1);
}

auto TrackModel::paste(int row, int column, const QList<QStringList> &lines) -> Pasted
{
    if (column == 0 && !beginWithNumbers(lines))
        column = 1;
    QList<Row> rows = mRows;
    int last = column;
    bool cut = false;
    const int taken = mFixed ? std::min(int(lines.size()), waitingRow() - row) : int(lines.size());
    for (int i = 0; i < taken; ++i) {
        fillUpTo(rows, row + i);
        const int end = std::min(columnCount(), column + int(lines[i].size()));
        for (int c = std::max(column, 1); c < end; ++c) {
            QString &cell = rows[row + i].texts[fieldOf(c)];
            const typedtext::Kept kept = typedtext::keep(lines[i][c - column], cell);
            cell = kept.text;
            cut = cut || kept.cut;
        }
        last = std::max(last, end - 1);
    }
    change(rows, row, column);
    return {index(row + taken - 1, last), cut};
}

QList<QStringList> TrackModel::parted(const QString &clipboard)
{
    QString text = text::withLineFeeds(clipboard);
    if (text.endsWith(u'\n'))
        text.chop(1);
    QList<QStringList> lines{{}};
    for (qsizetype at = 0; at <= text.size(); ++at) {
        lines.last().append(takeCell(text, at));
        if (at < text.size() && text[at] == u'\n')
            lines.append(QStringList());
    }
    return lines;
}

QString TrackModel::joined(const QList<QStringList> &lines)
{
    QStringList all;
    for (const QStringList &line : lines) {
        QStringList cells;
        for (const QString &cell : line)
            cells.append(readsAsItIs(cell) ? cell : inQuotes(cell));
        all.append(cells.join(u'\t'));
    }
    const bool endWouldGo = !all.isEmpty() && all.last().isEmpty();
    return all.join(u'\n') + (endWouldGo ? u"\n"_s : QString());
}

bool TrackModel::isTrack(const Row &row) const
{
    return mFixed || std::any_of(row.texts.begin(), row.texts.end(),
                                 [](const QString &text) { return !text.isEmpty(); });
}

bool TrackModel::isChanged(const Row &row) const
{
    const auto saved = mSaved.tracks.constFind(row.key);
    return saved == mSaved.tracks.cend() || saved->texts != row.texts;
}

// Empty rows that were never stored count for nothing.
bool TrackModel::isChanged() const
{
    qsizetype stored = 0;
    for (const Row &row : mRows) {
        if (!isTrack(row) && !mSaved.tracks.contains(row.key))
            continue;
        if (isChanged(row) || mSaved.order.value(stored) != row.key)
            return true;
        ++stored;
    }
    return stored != mSaved.order.size();
}

QList<TrackToSave> TrackModel::toSave() const
{
    QList<TrackToSave> tracks;
    for (const Row &row : mRows) {
        if (!isTrack(row))
            continue;
        const StoredTrack saved = mSaved.tracks.value(row.key);
        tracks.append({saved.linkId, isChanged(row), row.texts, saved.texts});
    }
    return tracks;
}

int TrackModel::rowOfTrack(qsizetype track) const
{
    return int(mNumbers.indexOf(int(track) + 1));
}

QList<qint64> TrackModel::savedLinks() const
{
    QList<qint64> links;
    for (const int key : mSaved.order)
        links.append(mSaved.tracks[key].linkId);
    return links;
}

void TrackModel::markSaved(const QList<qint64> &links)
{
    mSavedBefore = std::exchange(mSaved, {});
    for (const Row &row : std::as_const(mRows)) {
        if (!isTrack(row))
            continue;
        mSaved.tracks.insert(row.key, {links[mSaved.order.size()], row.texts});
        mSaved.order.append(row.key);
    }
}

void TrackModel::forgetSaved()
{
    mSaved = {};
    mSavedBefore = {};
}

void TrackModel::unmarkSaved()
{
    mSaved = mSavedBefore;
}

void TrackModel::change(QList<Row> rows, int row, int column)
{
    mUndo.append({mRows, {column, row}});
    mRedo.clear();
    show(std::move(rows));
}

// Rows come and go at the end alone, so that a view keeps its place and its widths.
void TrackModel::show(QList<Row> rows)
{
    const int more = int(rows.size() - mRows.size());
    if (more > 0)
        beginInsertRows({}, rowCount(), rowCount() + more - 1);
    else if (more < 0)
        beginRemoveRows({}, rowCount() + more, rowCount() - 1);
    mRows = std::move(rows);
    mNumbers.clear();
    int number = 0;
    for (const Row &row : std::as_const(mRows))
        mNumbers.append(isTrack(row) ? ++number : 0);
    if (more > 0) {
        endInsertRows();
    } else if (more < 0) {
        endRemoveRows();
    }
    emit dataChanged(index(0, 0), index(rowCount() - 1, columnCount() - 1));
}

void TrackModel::fillUpTo(QList<Row> &rows, int row)
{
    while (rows.size() <= row)
        rows.append(Row{++mLastKey, {}});
}

QModelIndex TrackModel::step(QList<Step> &from, QList<Step> &to)
{
    if (from.isEmpty())
        return {};
    Step taken = from.takeLast();
    to.append({mRows, taken.cell});
    show(std::move(taken.rows));
    return index(std::min(taken.cell.y(), rowCount() - 1), taken.cell.x());
}

int TrackModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : waitingRow() + (mFixed ? 0 : 1);
}

int TrackModel::columnCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : 1 + trackFields - mFirstField;
}

QVariant TrackModel::data(const QModelIndex &index, int role) const
{
    const bool number = index.column() == 0;
    if (role == Qt::TextAlignmentRole && number)
        return int(Qt::AlignRight | Qt::AlignVCenter);
    if (role != Qt::DisplayRole && role != Qt::EditRole)
        return {};
    if (!number)
        return text(index.row(), fieldOf(index.column()));
    if (index.row() == waitingRow())
        return u"*"_s;
    const int track = trackNumber(index.row());
    return track ? QString::number(track) : QString();
}

bool TrackModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    if (role != Qt::EditRole || index.column() == 0)
        return false;
    setText(index.row(), fieldOf(index.column()), value.toString());
    return true;
}

QVariant TrackModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation == Qt::Horizontal && role == Qt::DisplayRole)
        return mHeads.value(section);
    return {};
}

Qt::ItemFlags TrackModel::flags(const QModelIndex &index) const
{
    const Qt::ItemFlags flags = QAbstractTableModel::flags(index);
    return index.column() > 0 ? flags | Qt::ItemIsEditable : flags;
}
