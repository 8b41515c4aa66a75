#include "browser/qtDirModel.h"

#include "exBase.h"
#include "files/osNumberedName.h"
#include "peers/qtText.h"

#include <QApplication>
#include <QDateTime>
#include <QElapsedTimer>
#include <QLocale>
#include <QStyle>
#include <QTextDocument>

#include <algorithm>
#include <optional>
#include <unordered_set>
#include <utility>

namespace Kv
{

namespace
{

/// How long the loop waits for one slice of work, in milliseconds.
constexpr qint64 sliceLength = 4;

std::string foldCase(std::string const& text)
{
    return toQString(text).toCaseFolded().toStdString();
}

Qt::Alignment getAlignment(int column)
{
    if (column == QtDirModel::NameColumn)
        return Qt::AlignLeft | Qt::AlignVCenter;
    // Times are all as long; in the middle they keep away from the sizes.
    return column == QtDirModel::SizeColumn ? Qt::AlignRight | Qt::AlignVCenter : Qt::AlignCenter;
}

bool isSame(OsDirEntry const& a, OsDirEntry const& b)
{
    return a.name == b.name && a.title == b.title && a.isDirectory == b.isDirectory && a.size == b.size &&
           a.modified == b.modified;
}

} // namespace

QtDirModel::QtDirModel(QObject* parent, std::function<void()> onRead)
    : QAbstractTableModel(parent), _onRead(std::move(onRead)),
      _directoryIcon(QApplication::style()->standardIcon(QStyle::SP_DirIcon)),
      _fileIcon(QApplication::style()->standardIcon(QStyle::SP_FileIcon))
{
    _options.foldCase = &foldCase;
    connect(&_timer, &QTimer::timeout, this, [this] { work(); });
}

void QtDirModel::open(std::string const& directory, std::string const& hiddenName)
{
    _directory = directory;
    _options.hiddenName = hiddenName;
    replaceRows({}, {});
    reread();
}

void QtDirModel::reread()
{
    _sorting.reset();
    _readEntries.reset();
    try
    {
        _scan = std::make_unique<OsDirScan>(_directory, _options);
        _timer.start(0);
    }
    catch (ExBase const& error)
    {
        fail(error.getReason());
    }
}

void QtDirModel::rereadIfChanged()
{
    OsDirStamp const stamp = OsDirStamp::take(_directory);
    if (!isReading() && (!_error.empty() || !_stamp.isUnchangedIn(stamp)))
        reread();
}

OsDirEntry const& QtDirModel::getEntry(int row) const
{
    return _entries[static_cast<std::size_t>(_rows[static_cast<std::size_t>(row)])];
}

std::vector<int> QtDirModel::findRows(std::vector<std::string> const& names) const
{
    std::unordered_set<std::string> wanted(names.begin(), names.end());
    wanted.erase("");
    if (wanted.empty())
        return {};
    std::unordered_set<std::string> sequences;
    for (std::string const& name : names)
        if (std::optional<OsNumberedName> const numbered = OsNumberedName::parse(name))
            sequences.insert(numbered->getSequenceKey());
    std::vector<int> found;
    for (int row = 0; row < rowCount(); ++row)
        if (OsDirEntry const& entry = getEntry(row);
            wanted.count(entry.name) > 0 || (!entry.sequenceKey.empty() && sequences.count(entry.sequenceKey) > 0))
            found.push_back(row);
    return found;
}

int QtDirModel::rowCount(QModelIndex const& parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(_rows.size());
}

int QtDirModel::columnCount(QModelIndex const& parent) const
{
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant QtDirModel::data(QModelIndex const& index, int role) const
{
    OsDirEntry const& entry = getEntry(index.row());
    bool const isName = index.column() == NameColumn;
    if (role == Qt::DisplayRole)
        return getText(entry, index.column());
    if (role == Qt::DecorationRole && isName)
        return entry.isDirectory ? _directoryIcon : _fileIcon;
    if (role == Qt::ToolTipRole && isName)
        return Qt::convertFromPlainText(toShownPath(entry.title), Qt::WhiteSpaceNormal);
    if (role == Qt::TextAlignmentRole)
        return QVariant(getAlignment(index.column()));
    return {};
}

QVariant QtDirModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation != Qt::Horizontal)
        return {};
    if (role == Qt::TextAlignmentRole)
        return QVariant(getAlignment(section));
    if (role != Qt::DisplayRole)
        return {};
    return section == NameColumn ? QStringLiteral("Name")
                                 : (section == SizeColumn ? QStringLiteral("Size") : QStringLiteral("Modified"));
}

void QtDirModel::sort(int column, Qt::SortOrder order)
{
    _key = column == SizeColumn ? OsDirOrder::Size : column == ModifiedColumn ? OsDirOrder::Modified : OsDirOrder::Name;
    _descending = order == Qt::DescendingOrder;
    if (!_scan)
        startSorting(_readEntries ? *_readEntries : _entries);
}

void QtDirModel::work()
{
    QElapsedTimer clock;
    clock.start();
    try
    {
        while (!clock.hasExpired(sliceLength))
            if (advance())
            {
                _timer.stop();
                finish();
                return;
            }
    }
    catch (ExBase const& error)
    {
        fail(error.getReason());
    }
}

bool QtDirModel::advance()
{
    if (!_scan)
        return _sorting->step();
    if (_scan->step())
    {
        _stamp = _scan->getStamp();
        _readEntries = std::make_unique<std::vector<OsDirEntry>>(_scan->takeEntries());
        _scan.reset();
        startSorting(*_readEntries);
    }
    return false;
}

void QtDirModel::startSorting(std::vector<OsDirEntry> const& entries)
{
    _sorting = std::make_unique<OsDirOrder>(entries, _key, _descending);
    _timer.start(0);
}

void QtDirModel::finish()
{
    std::vector<int> rows = _sorting->take();
    _sorting.reset();
    if (!_readEntries)
    {
        reorderRows(std::move(rows));
        return;
    }
    _error.clear();
    std::unique_ptr<std::vector<OsDirEntry>> const entries = std::move(_readEntries);
    replaceRows(std::move(*entries), std::move(rows));
    _onRead();
}

void QtDirModel::fail(std::string const& reason)
{
    _timer.stop();
    _scan.reset();
    _error = reason;
    replaceRows({}, {});
    _onRead();
}

void QtDirModel::replaceRows(std::vector<OsDirEntry> entries, std::vector<int> rows)
{
    auto const isSameRow = [&](int mine, int other)
    { return isSame(_entries[static_cast<std::size_t>(mine)], entries[static_cast<std::size_t>(other)]); };
    if (std::equal(_rows.begin(), _rows.end(), rows.begin(), rows.end(), isSameRow))
        return;
    beginResetModel();
    _entries = std::move(entries);
    _rows = std::move(rows);
    endResetModel();
}

void QtDirModel::reorderRows(std::vector<int> rows)
{
    emit layoutAboutToBeChanged({}, VerticalSortHint);
    std::vector<int> newRows(rows.size());
    for (std::size_t row = 0; row < rows.size(); ++row)
        newRows[static_cast<std::size_t>(rows[row])] = static_cast<int>(row);
    QModelIndexList const before = persistentIndexList();
    QModelIndexList after;
    after.reserve(before.size());
    for (QModelIndex const& index : before)
    {
        int const entry = _rows[static_cast<std::size_t>(index.row())];
        after.append(this->index(newRows[static_cast<std::size_t>(entry)], index.column()));
    }
    _rows = std::move(rows);
    changePersistentIndexList(before, after);
    emit layoutChanged({}, VerticalSortHint);
}

QVariant QtDirModel::getText(OsDirEntry const& entry, int column) const
{
    if (column == NameColumn)
        return toShownPath(entry.title);
    if (column == ModifiedColumn)
        return QDateTime::fromSecsSinceEpoch(entry.modified).toString(QStringLiteral("yyyy-MM-dd hh:mm"));
    return entry.isDirectory ? QString() : QLocale().formattedDataSize(static_cast<qint64>(entry.size), 1);
}

} // namespace Kv
