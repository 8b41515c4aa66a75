#include "browser/qtDirModel.h"

#include "browser/qtNumberedName.h"
#include "exBase.h"
#include "files/osAsync.h"
#include "peers/qtText.h"

#include <QApplication>
#include <QDateTime>
#include <QLocale>
#include <QStyle>
#include <QTextDocument>

#include <algorithm>
#include <exception>
#include <optional>
#include <unordered_set>
#include <utility>

namespace Kv
{

namespace
{

Qt::Alignment getAlignment(int column)
{
    if (column == QtDirModel::NameColumn)
        return Qt::AlignLeft | Qt::AlignVCenter;
    // Times are all as long; in the middle they keep away from the sizes.
    return column == QtDirModel::SizeColumn ? Qt::AlignRight | Qt::AlignVCenter : Qt::AlignCenter;
}

bool isSame(QtDirEntry const& a, QtDirEntry const& b)
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
}

void QtDirModel::open(std::string const& directory, std::string const& hiddenName)
{
    _directory = directory;
    _options.hiddenName = hiddenName;
    replaceRows(nullptr, {});
    reread();
}

void QtDirModel::reread()
{
    _namer.cancel();
    _reader.start(OsAsync::getEntries(_directory), makeReading(_options));
}

void QtDirModel::showNames()
{
    if (!isReading() || (_listing && !hasNamesOnly()))
        return;
    QtDirListing::Options options = _options;
    options.asksEntries = false;
    _namer.start(_directory, makeReading(options));
}

QtDirWorker::Work QtDirModel::makeReading(QtDirListing::Options const& options)
{
    return [this, directory = _directory, options, key = _key,
            descending = _descending](std::atomic<bool> const& cancelled) -> std::function<void()>
    {
        try
        {
            auto const listing = std::make_shared<QtDirListing const>(directory, options, cancelled);
            return [this, listing, rows = listing->sort(key, descending)]
            {
                _error.clear();
                replaceRows(listing, rows);
                _onRead();
            };
        }
        catch (ExBase const& error)
        {
            return [this, reason = std::string(error.getReason())] { fail(reason); };
        }
        catch (std::exception const& error)
        {
            return [this, reason = std::string(error.what())] { fail(reason); };
        }
    };
}

void QtDirModel::rereadIfChanged(QtDirStamp const& now)
{
    if (!isReading() && (!_listing || !_listing->getStamp().isUnchangedIn(now)))
        reread();
}

QtDirEntry const& QtDirModel::getEntry(int row) const
{
    return _listing->getEntries()[static_cast<std::size_t>(_rows[static_cast<std::size_t>(row)])];
}

std::vector<int> QtDirModel::findRows(std::vector<std::string> const& names) const
{
    std::unordered_set<std::string> wanted(names.begin(), names.end());
    wanted.erase("");
    if (wanted.empty())
        return {};
    std::unordered_set<std::string> sequences;
    for (std::string const& name : names)
        if (std::optional<QtNumberedName> const numbered = QtNumberedName::parse(name))
            sequences.insert(numbered->getSequenceKey());
    std::vector<int> found;
    for (int row = 0; row < rowCount(); ++row)
        if (QtDirEntry const& entry = getEntry(row);
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
    QtDirEntry const& entry = getEntry(index.row());
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
    _key = column == SizeColumn       ? QtDirListing::Size
           : column == ModifiedColumn ? QtDirListing::Modified
                                      : QtDirListing::Name;
    _descending = order == Qt::DescendingOrder;
    if (_listing)
        _sorter.start("", [this, listing = _listing, key = _key, descending = _descending](std::atomic<bool> const&)
                      { return [this, rows = listing->sort(key, descending)] { reorderRows(rows); }; });
    if (isReading())
        reread();
}

void QtDirModel::fail(std::string const& reason)
{
    _error = reason;
    replaceRows(nullptr, {});
    _onRead();
}

void QtDirModel::replaceRows(Listing listing, std::vector<int> rows)
{
    auto const isSameRow = [&](int mine, int other)
    {
        return isSame(_listing->getEntries()[static_cast<std::size_t>(mine)],
                      listing->getEntries()[static_cast<std::size_t>(other)]);
    };
    // What is under way for rows that go.
    _sorter.cancel();
    if (!isReading())
        _namer.cancel();
    bool const isNew = !std::equal(_rows.begin(), _rows.end(), rows.begin(), rows.end(), isSameRow);
    if (isNew)
        beginResetModel();
    _listing = std::move(listing);
    _rows = std::move(rows);
    if (isNew)
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

QVariant QtDirModel::getText(QtDirEntry const& entry, int column) const
{
    if (column == NameColumn)
        return toShownPath(entry.title);
    if (hasNamesOnly())
        return {};
    if (column == ModifiedColumn)
        return QDateTime::fromSecsSinceEpoch(entry.modified).toString(QStringLiteral("yyyy-MM-dd hh:mm"));
    return entry.isDirectory ? QString() : QLocale().formattedDataSize(static_cast<qint64>(entry.size), 1);
}

} // namespace Kv
