#include "browser/qtBrowserList.h"

#include "browser/qtDirModel.h"

#include <QHeaderView>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QStyledItemDelegate>

#include <utility>

namespace Kv
{

namespace
{

bool isJump(int key)
{
    return key == Qt::Key_Home || key == Qt::Key_End || key == Qt::Key_PageUp || key == Qt::Key_PageDown;
}

/// Gives the rows air.
class RowDelegate final : public QStyledItemDelegate
{
public:
    using QStyledItemDelegate::QStyledItemDelegate;

    QSize sizeHint(QStyleOptionViewItem const& option, QModelIndex const& index) const override
    {
        constexpr int air = 6;
        return QStyledItemDelegate::sizeHint(option, index) + QSize(0, air);
    }

protected:
    void initStyleOption(QStyleOptionViewItem* option, QModelIndex const& index) const override
    {
        QStyledItemDelegate::initStyleOption(option, index);
        if (index.column() == QtDirModel::NameColumn)
            return;
        // The name is what is read; the rest steps back.
        QColor text = option->palette.color(QPalette::Text);
        text.setAlphaF(0.65F);
        option->palette.setColor(QPalette::Text, text);
    }
};

} // namespace

QtBrowserList::QtBrowserList(QWidget* parent, Actions actions) : QTreeView(parent), _actions(std::move(actions))
{
    setItemDelegate(new RowDelegate(this));
    setRootIsDecorated(false);
    setItemsExpandable(false);
    setUniformRowHeights(true);
    setAllColumnsShowFocus(true);
    setEditTriggers(NoEditTriggers);
    setTabKeyNavigation(false);
    setTextElideMode(Qt::ElideMiddle);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setVerticalScrollMode(ScrollPerPixel);
    header()->setStretchLastSection(false);
    header()->setSectionsMovable(false);
    header()->setHighlightSections(false);
    header()->setSortIndicator(QtDirModel::NameColumn, Qt::AscendingOrder);
}

void QtBrowserList::setPlaceholder(QString const& text)
{
    _placeholder = text;
    viewport()->update();
}

void QtBrowserList::keyPressEvent(QKeyEvent* event)
{
    bool const isEnter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    bool const isArrow = event->key() == Qt::Key_Down || event->key() == Qt::Key_Up;
    // With Alt the arrows are not for the rows.
    if (event->modifiers() & Qt::AltModifier)
        event->ignore();
    else if (event->key() == Qt::Key_Backspace)
        _actions.goUp();
    else if ((isEnter && event->isAutoRepeat()) || ((isEnter || isArrow) && selectFirst()))
        event->accept();
    else if (isEnter)
        _actions.activate();
    else
    {
        QTreeView::keyPressEvent(event);
        // A jump to the row that the keyboard is on already would select nothing.
        if (isJump(event->key()))
            selectFirst();
    }
}

void QtBrowserList::mousePressEvent(QMouseEvent* event)
{
    if (!indexAt(event->position().toPoint()).isValid())
        setCurrentIndex(QModelIndex());
    QTreeView::mousePressEvent(event);
}

void QtBrowserList::mouseDoubleClickEvent(QMouseEvent* event)
{
    QTreeView::mouseDoubleClickEvent(event);
    bool const isLeft = event->button() == Qt::LeftButton;
    if (isLeft && currentIndex().isValid() && indexAt(event->position().toPoint()).row() == currentIndex().row())
        _actions.activate();
}

void QtBrowserList::resizeEvent(QResizeEvent* event)
{
    QTreeView::resizeEvent(event);
    fitColumns();
}

void QtBrowserList::paintEvent(QPaintEvent* event)
{
    QTreeView::paintEvent(event);
    if (_placeholder.isEmpty() || model()->rowCount() > 0)
        return;
    QPainter painter(viewport());
    painter.setPen(palette().color(QPalette::PlaceholderText));
    painter.drawText(viewport()->rect(), Qt::AlignCenter | Qt::TextWordWrap, _placeholder);
}

void QtBrowserList::changeEvent(QEvent* event)
{
    QTreeView::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange)
        fitColumns();
}

bool QtBrowserList::selectFirst()
{
    if (!currentIndex().isValid() || selectionModel()->hasSelection())
        return false;
    setCurrentIndex(currentIndex());
    return true;
}

void QtBrowserList::fitColumns()
{
    if (!model())
        return;
    QFontMetrics const metrics = fontMetrics();
    int const air = 3 * metrics.averageCharWidth();
    int const sizeWidth = metrics.horizontalAdvance(QStringLiteral("1023.9 KiB")) + air;
    int const timeWidth = metrics.horizontalAdvance(QStringLiteral("2000-00-00 00:00")) + 2 * air;
    // In characters: what the name keeps before it gives room to the others.
    constexpr int leastBesideSize = 22;
    constexpr int leastBesideAll = 34;
    int const room = viewport()->width();
    header()->setSectionResizeMode(QtDirModel::NameColumn, QHeaderView::Stretch);
    header()->resizeSection(QtDirModel::SizeColumn, sizeWidth);
    header()->resizeSection(QtDirModel::ModifiedColumn, timeWidth);
    int const nameUnit = metrics.averageCharWidth();
    setColumnHidden(QtDirModel::SizeColumn, room < leastBesideSize * nameUnit + sizeWidth);
    setColumnHidden(QtDirModel::ModifiedColumn, room < leastBesideAll * nameUnit + sizeWidth + timeWidth);
}

} // namespace Kv
