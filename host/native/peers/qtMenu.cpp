#include "ntMenu.h"
#include "peers/qtLongText.h"
#include "peers/qtPeer.h"
#include "peers/qtText.h"
#include "peers/qtUnseen.h"
#include "windows/qtFocusOrder.h"

#include <QAbstractItemView>
#include <QComboBox>
#include <QScreen>
#include <QScrollBar>
#include <QStylePainter>
#include <QWheelEvent>

#include <algorithm>

namespace Kv
{

namespace
{

/// The number of entries that a popup shows at once; with more it scrolls.
constexpr int maxShown = 20;

class ComboBox final : public QComboBox, public QtValueWidget
{
public:
    ComboBox(QWidget* parent, QtListenerHandle<NtMenuListener> const& handle) : QComboBox(parent), _handle(handle)
    {
        // The wheel alone must not take the keyboard.
        setFocusPolicy(Qt::StrongFocus);
        setMaxVisibleItems(maxShown);
        connect(this, &QComboBox::activated, this, [this](int index) { tellPicked(index); });
    }

    void setAlign(NtAlign align)
    {
        _align = align;
        update();
    }

    /// As high as a line of text needs; the cell gives the width. Qt's own hint looks at all entries, and asked for one
    /// that does not, Qt makes the popup of each box at once.
    QSize sizeHint() const override
    {
        QStyleOptionComboBox option;
        initStyleOption(&option);
        constexpr int air = 2;
        return style()->sizeFromContents(QStyle::CT_ComboBox, &option,
                                         QSize(0, std::max(fontMetrics().height(), iconSize().height()) + air), this);
    }

    QSize minimumSizeHint() const override { return sizeHint(); }

    void showPopup() override
    {
        shortenPopup();
        widenPopup();
        QComboBox::showPopup();
    }

protected:
    bool event(QEvent* event) override
    {
        if (event->type() == QEvent::ToolTip && fontMetrics().horizontalAdvance(currentText()) > getTextWidth())
            return showWhole(*this, *event, currentText());
        return QComboBox::event(event);
    }

    void showEvent(QShowEvent* event) override
    {
        // Qt's own announces a new size, as a box gets that is as wide as its entries.
        QWidget::showEvent(event); // NOLINT(bugprone-parent-virtual-call)
    }

    void paintEvent(QPaintEvent*) override
    {
        QStylePainter painter(this);
        QStyleOptionComboBox option;
        initStyleOption(&option);
        painter.drawComplexControl(QStyle::CC_ComboBox, option);
        option.currentText = fontMetrics().elidedText(option.currentText, Qt::ElideRight, getTextWidth());
        option.textAlignment = toQtAlignment(_align);
        painter.drawControl(QStyle::CE_ComboBoxLabel, option);
    }

    void wheelEvent(QWheelEvent* event) override
    {
        // Turned over it on the way through a long dialog, the wheel scrolls the dialog.
        if (hasFocus())
            QComboBox::wheelEvent(event);
        else
            event->ignore();
    }

private:
    /// Gives many entries a list with a scroll bar: styles that open a box like a menu fill the screen with them.
    void shortenPopup()
    {
        bool const isLong = count() > maxShown;
        QString const sheet = isLong ? QStringLiteral("QComboBox { combobox-popup: 0; }") : QString();
        if (styleSheet() == sheet)
            return;
        setStyleSheet(sheet);
        view()->setVerticalScrollBarPolicy(isLong ? Qt::ScrollBarAsNeeded : Qt::ScrollBarAlwaysOff);
    }

    /// Makes room in the popup for the longest entry, as far as the screen goes.
    void widenPopup()
    {
        QAbstractItemView* const list = view();
        QMargins const margins = list->contentsMargins();
        int const needed = list->sizeHintForColumn(0) + list->verticalScrollBar()->sizeHint().width() + margins.left() +
                           margins.right();
        list->setMinimumWidth(std::min(needed, screen()->availableSize().width()));
    }

    int getTextWidth() const
    {
        QStyleOptionComboBox option;
        initStyleOption(&option);
        return style()->subControlRect(QStyle::CC_ComboBox, &option, QStyle::SC_ComboBoxEditField, this).width();
    }

    void tellPicked(int index) const
    {
        if (isVisible())
            _handle.tell(&NtMenuListener::onPicked, index);
    }

    QtListenerHandle<NtMenuListener> _handle;
    NtAlign _align = NtAlign::Left;
};

/// A combo box, with room in its popup for long entries.
class Menu final : public QtPeerOf<NtMenu, ComboBox>
{
public:
    Menu(QWidget* parent, std::string const& name, NtMenu::Listener& listener)
        : QtPeerOf(parent, name, rowInset, listener)
    {
    }

    void removeAll() override
    {
        ComboBox* const box = getNative();
        if (!box)
            return;
        QtUnseen const unseen(*box);
        box->clear();
    }

    void append(std::string const& entry) override
    {
        ComboBox* const box = getNative();
        if (!box)
            return;
        QtUnseen const unseen(*box);
        // The first entry would select itself.
        int const selected = box->currentIndex();
        box->addItem(toShown(toQString(entry), mostInRow));
        box->setCurrentIndex(selected);
    }

    void select(int index) override
    {
        ComboBox* const box = getNative();
        if (!box)
            return;
        QtUnseen const unseen(*box);
        box->setCurrentIndex(index);
    }

    void setAlign(NtAlign align) override
    {
        if (ComboBox* const box = getNative())
            box->setAlign(align);
    }
};

QtPeerKind<NtMenu, Menu> registered;

} // namespace

} // namespace Kv
