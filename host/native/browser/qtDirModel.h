#pragma once

#include "browser/qtDirListing.h"
#include "browser/qtDirWorker.h"

#include <QAbstractTableModel>
#include <QIcon>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace Kv
{

/// The listing of a directory as a table, a row an entry. A worker reads and sorts; until that is done the rows stay as
/// they were.
class QtDirModel final : public QAbstractTableModel
{
public:
    enum Column
    {
        NameColumn,
        SizeColumn,
        ModifiedColumn,
        ColumnCount,
    };

    /// `onRead` is called when a reading has ended, well or with an error, or the names are there. The rows are then
    /// new.
    QtDirModel(QObject* parent, std::function<void()> onRead);

    void setCollapsing(std::function<bool(std::string const&)> collapses) { _options.collapses = std::move(collapses); }

    bool showsHidden() const { return _options.showsHidden; }
    void setShowsHidden(bool shows) { _options.showsHidden = shows; }

    /// Has no rows from now on and reads a directory. `hiddenName` is shown also where hidden files are not.
    void open(std::string const& directory, std::string const& hiddenName);

    /// Reads the directory again.
    void reread();

    /// Reads the directory again where it has changed since it was read, by how it is now.
    void rereadIfChanged(QtDirStamp const& now);

    /// Makes do with the names, where the reading takes long and nothing else has been read, until it has ended.
    void showNames();

    bool isReading() const { return _reader.isBusy(); }

    /// True while the rows have neither a size nor a time.
    bool hasNamesOnly() const { return _listing && !_listing->hasDetails(); }

    /// The reason why the directory could not be read, in words; else empty.
    std::string const& getError() const { return _error; }

    QtDirEntry const& getEntry(int row) const;

    /// The rows, from top to bottom, of files and directories, or of the sequences that they are part of.
    std::vector<int> findRows(std::vector<std::string> const& names) const;

    int rowCount(QModelIndex const& parent = QModelIndex()) const override;
    int columnCount(QModelIndex const& parent = QModelIndex()) const override;
    QVariant data(QModelIndex const& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    void sort(int column, Qt::SortOrder order) override;

private:
    using Listing = std::shared_ptr<QtDirListing const>;

    QtDirWorker::Work makeReading(QtDirListing::Options const& options);
    void fail(std::string const& reason);
    void replaceRows(Listing listing, std::vector<int> rows);
    void reorderRows(std::vector<int> rows);
    QVariant getText(QtDirEntry const& entry, int column) const;

    std::function<void()> _onRead;
    std::string _directory;
    QtDirListing::Options _options;
    std::string _error;

    Listing _listing;
    /// The entries of the listing as they stand from top to bottom.
    std::vector<int> _rows;

    QtDirListing::Key _key = QtDirListing::Name;
    bool _descending = false;
    QIcon _directoryIcon;
    QIcon _fileIcon;
    QtDirWorker _reader;
    QtDirWorker _namer;
    QtDirWorker _sorter;
};

} // namespace Kv
