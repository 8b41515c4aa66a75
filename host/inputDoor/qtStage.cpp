#include "qtStage.h"

#include "exBase.h"
#include "ntContainer.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAccessible>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>

#include <algorithm>
#include <optional>

namespace Kv
{

namespace
{

bool isFloat(QWidget const& widget)
{
    return widget.property(ntFloatMark).toBool();
}

/// The uppermost float that takes input; null if there is none.
QWidget* findFloat()
{
    QWidget* found = nullptr;
    for (QWidget* const window : QApplication::topLevelWidgets())
        for (QWidget* const widget : window->findChildren<QWidget*>())
            if (isFloat(*widget) && widget->isVisible() && widget->isEnabled())
                found = widget;
    return found;
}

std::optional<IdKind> kindOf(QWidget const& widget)
{
    if (qobject_cast<QLabel const*>(&widget))
        return IdKind::Label;
    if (qobject_cast<QLineEdit const*>(&widget))
        return IdKind::Field;
    if (qobject_cast<QCheckBox const*>(&widget))
        return IdKind::Toggle;
    if (qobject_cast<QComboBox const*>(&widget))
        return IdKind::Menu;
    if (qobject_cast<QAbstractItemView const*>(&widget))
        return IdKind::List;
    if (qobject_cast<QAbstractButton const*>(&widget))
        return IdKind::Button;
    return {};
}

/// True for a widget of the dialog's own: not the title, a part of another widget, or what lies in a popup.
bool isContent(QWidget const& widget, QWidget const& dialog)
{
    QWidget const* const parent = widget.parentWidget();
    bool const isTitle = isFloat(dialog) && parent == &dialog && qobject_cast<QLabel const*>(&widget);
    return kindOf(widget) && !kindOf(*parent) && widget.window() == dialog.window() && !isTitle;
}

std::vector<QWidget*> sortAsTheEyeGoes(std::vector<QWidget*> widgets, QWidget const& dialog)
{
    auto const centre = [&dialog](QWidget const* widget) { return widget->mapTo(&dialog, widget->rect().center()); };
    std::stable_sort(widgets.begin(), widgets.end(),
                     [&centre](QWidget* a, QWidget* b) { return centre(a).y() < centre(b).y(); });
    // A row is what stands beside its uppermost widget.
    for (auto row = widgets.begin(); row != widgets.end();)
    {
        int const lowest = centre(*row).y() + (*row)->height() / 2;
        auto const end = std::find_if(row, widgets.end(),
                                      [&centre, lowest](QWidget* widget) { return centre(widget).y() >= lowest; });
        auto const next = end == row ? row + 1 : end;
        std::stable_sort(row, next, [&centre](QWidget* a, QWidget* b) { return centre(a).x() < centre(b).x(); });
        row = next;
    }
    return widgets;
}

/// The name that a screen reader says.
QString getSpokenName(QWidget& widget)
{
    // Qt says the selected entry of a menu where nothing stands beside it.
    QAccessibleInterface* const face = QAccessible::queryAccessibleInterface(&widget);
    return face && !qobject_cast<QComboBox*>(&widget) ? face->text(QAccessible::Name) : widget.accessibleName();
}

QString getText(QWidget& widget)
{
    if (auto const* const field = qobject_cast<QLineEdit*>(&widget))
        return field->text();
    if (auto const* const menu = qobject_cast<QComboBox*>(&widget))
        return menu->currentText();
    if (auto const* const list = qobject_cast<QAbstractItemView*>(&widget))
        return list->currentIndex().siblingAtColumn(0).data().toString();
    if (qobject_cast<QLabel*>(&widget))
        return getSpokenName(widget);
    return {};
}

IdWidget describe(QWidget& widget, QWidget const& dialog)
{
    IdWidget result;
    result.kind = *kindOf(widget);
    result.name = widget.objectName().toStdString();
    result.caption = result.kind == IdKind::Label ? std::string() : getSpokenName(widget).toStdString();
    result.text = getText(widget).toStdString();
    auto const* const button = qobject_cast<QAbstractButton*>(&widget);
    result.isOn = button && button->isChecked();
    result.isShown = widget.isVisible();
    result.isEnabled = widget.isEnabled();
    // Where no window system says so, an open window may not be active.
    QWidget const* const holder = QApplication::focusWidget();
    result.hasKeyboard = (holder ? holder : dialog.window()->focusWidget()) == &widget;
    return result;
}

} // namespace

QWidget* QtStage::findDialog()
{
    QWidget* const modal = QApplication::activeModalWidget();
    return modal ? modal : findFloat();
}

QString QtStage::getTitle(QWidget const& dialog)
{
    return dialog.isWindow() ? dialog.windowTitle().replace(QLatin1String("[*][*]"), QLatin1String("[*]"))
                             : dialog.accessibleName();
}

std::vector<IdWidget> QtStage::look()
{
    _widgets.clear();
    QWidget const* const dialog = findDialog();
    if (!dialog)
        return {};
    std::vector<QWidget*> content;
    for (QWidget* const widget : dialog->findChildren<QWidget*>())
        if (isContent(*widget, *dialog))
            content.push_back(widget);
    std::vector<IdWidget> result;
    for (QWidget* const widget : sortAsTheEyeGoes(std::move(content), *dialog))
    {
        _widgets.emplace_back(widget);
        result.push_back(describe(*widget, *dialog));
    }
    return result;
}

QWidget& QtStage::get(std::size_t place) const
{
    if (place >= _widgets.size() || !_widgets[place])
        throw ExBase(__FILE__, __LINE__, "The widget is gone");
    return *_widgets[place];
}

} // namespace Kv
