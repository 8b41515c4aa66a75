#include "browser/qtBrowserSelection.h"

#include "browser/qtBrowserList.h"
#include "browser/qtDirModel.h"

#include <QScrollBar>

#include <algorithm>
#include <utility>

namespace Kv
{

QtBrowserSelection::QtBrowserSelection(QtBrowserList& list, QtDirModel& model, std::function<void()> onChosen)
    : QObject(&list), _list(list), _model(model), _onChosen(std::move(onChosen))
{
    connect(_list.selectionModel(), &QItemSelectionModel::selectionChanged, this, [this] { onChanged(); });
    connect(_list.selectionModel(), &QItemSelectionModel::currentChanged, this, [this] { onChanged(); });
    connect(&_model, &QAbstractItemModel::modelAboutToBeReset, this, [this] { onRowsGo(); });
}

void QtBrowserSelection::await(QtBrowserChoice const& choice)
{
    _wanted = choice;
    _view = {};
    _awaiting = true;
}

bool QtBrowserSelection::settle()
{
    bool const isNew = std::exchange(_awaiting, false);
    if (std::exchange(_replaced, false) || isNew)
        selectWanted();
    return isNew && _wanted.selected.size() <= 1 && !_model.findRows({_wanted.focus}).empty();
}

void QtBrowserSelection::onChanged() const
{
    if (!_settling)
        _onChosen();
}

void QtBrowserSelection::onRowsGo()
{
    _replaced = true;
    if (_awaiting)
        return;
    _wanted = get();
    QModelIndex const current = _list.currentIndex();
    QModelIndex const top = _list.indexAt(QPoint(0, 0));
    _view.current = current.isValid() ? _model.getEntry(current.row()).name : "";
    _view.top = top.isValid() ? _model.getEntry(top.row()).name : "";
    _view.offset = _list.visualRect(top).y();
    _view.scroll = _list.verticalScrollBar()->value();
}

void QtBrowserSelection::selectWanted()
{
    std::vector<std::string> names = _wanted.selected;
    names.push_back(_wanted.focus);
    int const columns = _model.columnCount() - 1;
    QItemSelection selection;
    for (int const row : _model.findRows(names))
        selection.select(_model.index(row, 0), _model.index(row, columns));
    _settling = true;
    _list.selectionModel()->select(selection, QItemSelectionModel::ClearAndSelect);
    restoreView();
    _settling = false;
}

void QtBrowserSelection::restoreView()
{
    auto const indexOf = [this](std::string const& name)
    {
        std::vector<int> const rows = _model.findRows({name});
        return rows.empty() ? QModelIndex() : _model.index(rows.front(), 0);
    };
    QModelIndex const focus = indexOf(_wanted.focus.empty() ? _view.current : _wanted.focus);
    // The keyboard is always on some row: from none, the list would take every key for a step to the first.
    _list.selectionModel()->setCurrentIndex(focus.isValid() ? focus : _model.index(0, 0),
                                            QItemSelectionModel::NoUpdate);
    _list.doItemsLayout();
    QModelIndex const top = indexOf(_view.top);
    if (_view.top.empty())
        _list.scrollTo(focus);
    else if (_view.scroll > 0 && top.isValid())
    {
        _list.scrollTo(top, QAbstractItemView::PositionAtTop);
        _list.verticalScrollBar()->setValue(_list.verticalScrollBar()->value() - _view.offset);
    }
    else
        _list.verticalScrollBar()->setValue(_view.scroll);
}

QtBrowserChoice QtBrowserSelection::get() const
{
    std::vector<int> rows;
    for (QModelIndex const& index : _list.selectionModel()->selectedRows())
        rows.push_back(index.row());
    std::sort(rows.begin(), rows.end());
    QtBrowserChoice choice;
    for (int const row : rows)
        choice.selected.push_back(_model.getEntry(row).name);
    QModelIndex const current = _list.currentIndex();
    if (current.isValid() && std::binary_search(rows.begin(), rows.end(), current.row()))
        choice.focus = _model.getEntry(current.row()).name;
    else if (!rows.empty())
        choice.focus = choice.selected.front();
    return choice;
}

} // namespace Kv
