#include "qtHand.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QApplication>
#include <QComboBox>
#include <QKeySequence>
#include <QLineEdit>
#include <QPointer>
#include <QScrollArea>
#include <QTest>
#include <QWindow>

namespace Kv
{

namespace
{

void scrollIntoView(QWidget& widget)
{
    // A title can cover the upper edge of what is scrolled.
    int const margin = 2 * widget.height();
    for (QWidget* around = widget.parentWidget(); around; around = around->parentWidget())
        if (auto* const area = qobject_cast<QScrollArea*>(around))
            area->ensureWidgetVisible(&widget, 0, margin);
}

/// Moves the pointer into the widget's window, and there to a place of the widget.
void pointAt(QWidget& widget, QPoint const& place)
{
    QWidget* const window = widget.window();
    QTest::mouseMove(window->windowHandle(), widget.mapTo(window, place));
}

void clickAt(QWidget& widget, QPoint const& place, Qt::KeyboardModifiers modifiers = {})
{
    QPointer<QWidget> const shell(widget.window());
    QPointer<QAbstractButton> const button(qobject_cast<QAbstractButton*>(&widget));
    QPointer<QWindow> const window = shell->windowHandle();
    QPoint const position = widget.mapTo(widget.window(), place);
    pointAt(widget, place);
    // An open popup, such as suggestions for a path, would take the first click to go.
    QWidget* const popup = QApplication::activePopupWidget();
    if (popup && popup != shell)
        popup->close();
    constexpr int attempts = 3;
    bool isTaken = false;
    for (int attempt = 0; attempt < attempts && window && !isTaken; ++attempt)
    {
        QTest::mousePress(window, Qt::LeftButton, modifiers, position);
        // What the window system had still to say of a popup that has gone takes the press away from a button: a person
        // presses again.
        isTaken = !button || button->isDown();
        // What was pressed may have gone.
        if (window)
            QTest::mouseRelease(window, Qt::LeftButton, modifiers, position);
    }
}

void pressKey(QWindow& window, int key, QString const& text, Qt::KeyboardModifiers modifiers = {})
{
    QTest::sendKeyEvent(QTest::Click, &window, static_cast<Qt::Key>(key), text, modifiers);
}

/// The key that gives the character on most keyboards, as far as widgets ask for it.
int keyOf(QString const& character)
{
    if (character == QLatin1String("\n"))
        return Qt::Key_Return;
    if (character == QLatin1String("\t"))
        return Qt::Key_Tab;
    ushort const code = character.front().toUpper().unicode();
    return code < 0x100 ? static_cast<int>(code) : static_cast<int>(Qt::Key_unknown);
}

QPoint getSeenCentre(QWidget const& widget)
{
    return widget.visibleRegion().boundingRect().center();
}

} // namespace

QString QtHand::findObstacle(QWidget& widget)
{
    if (!widget.isVisible())
        return QStringLiteral("is hidden");
    if (!widget.isEnabled())
        return QStringLiteral("is disabled");
    if (auto const* const field = qobject_cast<QLineEdit*>(&widget); field && field->isReadOnly())
        return QStringLiteral("is read-only");
    scrollIntoView(widget);
    if (widget.visibleRegion().isEmpty())
        return QStringLiteral("is out of sight");
    QWidget* const window = widget.window();
    QWidget* const hit = window->childAt(widget.mapTo(window, getSeenCentre(widget)));
    if (!hit || hit == &widget || widget.isAncestorOf(hit))
        return {};
    QString const name = hit->objectName();
    return name.isEmpty() ? QStringLiteral("is covered") : QStringLiteral("is covered by \"%1\"").arg(name);
}

void QtHand::click(QWidget& widget)
{
    clickAt(widget, getSeenCentre(widget));
}

void QtHand::pick(QAbstractItemView& list, int row, bool isMore)
{
    QModelIndex const index = list.model()->index(row, 0, list.rootIndex());
    list.scrollTo(index);
    clickAt(*list.viewport(), list.visualRect(index).center(), isMore ? Qt::ControlModifier : Qt::NoModifier);
}

void QtHand::pick(QComboBox& menu, int entry)
{
    QPointer<QAbstractItemView> const list = menu.view();
    QModelIndex const index = list->model()->index(entry, menu.modelColumn(), list->rootIndex());
    click(menu);
    // The click may have had the menu closed, or deleted.
    if (!list || !list->isVisible())
        return;
    list->scrollTo(index);
    // Enter, not a second click: the popup takes one that follows so soon for the release of the first.
    pointAt(*list->viewport(), list->visualRect(index).center());
    if (list && list->window()->windowHandle())
        pressKey(*list->window()->windowHandle(), Qt::Key_Return, QStringLiteral("\r"));
}

void QtHand::type(QWidget& dialog, QString const& text)
{
    QPointer<QWindow> const window = dialog.window()->windowHandle();
    for (int at = 0; at < text.size() && window && window->isVisible();)
    {
        int const length = text.at(at).isHighSurrogate() ? 2 : 1;
        QString const character = text.mid(at, length);
        pressKey(*window, keyOf(character), character == QLatin1String("\n") ? QStringLiteral("\r") : character);
        at += length;
    }
}

bool QtHand::press(QWidget& dialog, QString const& key)
{
    QKeySequence const keys = QKeySequence::fromString(key, QKeySequence::PortableText);
    if (keys.count() != 1 || keys[0].key() == Qt::Key_unknown)
        return false;
    QKeyCombination const combination = keys[0];
    QString const text = combination.key() == Qt::Key_Space ? QStringLiteral(" ") : key;
    pressKey(*dialog.window()->windowHandle(), combination.key(), text.size() == 1 ? text : QString(),
             combination.keyboardModifiers());
    return true;
}

} // namespace Kv
