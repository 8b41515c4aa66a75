#pragma once

#include "files/osDirOrder.h"
#include "files/osDirScan.h"

#include <QAbstractTableModel>
#include <QIcon>
#include <QTimer>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace Kv
{

/// The listing of a directory as a table, a row an entry. It reads and sorts in slices of a few milliseconds whenever
/// the loop has nothing else to do; until a reading is done the rows stay as they were.
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

    /// `onRead` is called when a reading has ended, well or with an error. The rows are then new.
    QtDirModel(QObject* parent, std::function<void()> onRead);

    void setCollapsing(std::function<bool(std::string const&)> collapses) { _options.collapses = std::move(collapses); }

    bool showsHidden() const { return _options.showsHidden; }
    void setShowsHidden(bool shows) { _options.showsHidden = shows; }

    /// Has no rows from now on and reads a directory. `hiddenName` is shown also where hidden files are not.
    void open(std::string const& directory, std::string const& hiddenName);

    /// Reads the directory again.
    void reread();

    /// Reads the directory again where it has changed. Throws an `ExBase` where it cannot be asked.
    void rereadIfChanged();

    bool isReading() const { return _timer.isActive(); }

    /// Why the directory could not be read, in words; else empty.
    std::string const& getError() const { return _error; }

    OsDirEntry const& getEntry(int row) const;

    /// The rows, from top to bottom, of files and directories, or of the sequences that they are part of.
    std::vector<int> findRows(std::vector<std::string> const& names) const;

    int rowCount(QModelIndex const& parent = QModelIndex()) const override;
    int columnCount(QModelIndex const& parent = QModelIndex()) const override;
    QVariant data(QModelIndex const& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    void sort(int column, Qt::SortOrder order) override;

private:
    void work();
    /// True once the work at hand is done.
    bool advance();
    void startSorting(std::vector<OsDirEntry> const& entries);
    void finish();
    void fail(std::string const& reason);
    void replaceRows(std::vector<OsDirEntry> entries, std::vector<int> rows);
    void reorderRows(std::vector<int> rows);
    QVariant getText(OsDirEntry const& entry, int column) const;

    std::function<void()> _onRead;
    std::string _directory;
    OsDirScan::Options _options;
    OsDirStamp _stamp;
    std::string _error;

    std::vector<OsDirEntry> _entries;
    /// The entries as they stand from top to bottom.
    std::vector<int> _rows;

    /// The work at hand: a reading, then its sorting, or the sorting of the rows that there are.
    std::unique_ptr<OsDirScan> _scan;
    std::unique_ptr<std::vector<OsDirEntry>> _readEntries;
    std::unique_ptr<OsDirOrder> _sorting;
    QTimer _timer;

    OsDirOrder::Key _key = OsDirOrder::Name;
    bool _descending = false;
    QIcon _directoryIcon;
    QIcon _fileIcon;
};

} // namespace Kv
