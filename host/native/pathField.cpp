#include "native/pathField.h"

#include "base/exBase.h"
#include "native/pathCompleter.h"
#include "native/qtText.h"
#include "resmgt/osPlace.h"

#include <QAbstractItemView>
#include <QKeyEvent>

#include <utility>

namespace Kv
{

PathField::PathField(QWidget* parent, std::function<void()> onEnter)
    : QLineEdit(parent), _onEnter(std::move(onEnter)), _completer(new PathCompleter(this, [this] { showProposals(); }))
{
    setCompleter(_completer);
    connect(this, &QLineEdit::textEdited, this, [this] { propose(); });
}

void PathField::setDirectory(std::string const& directory)
{
    _directory = directory;
    _shown = toShownPath(directory);
    setText(_shown);
}

bool PathField::isEdited() const
{
    return text() != _shown;
}

std::string PathField::getTypedPath() const
{
    return toTypedPath(text());
}

void PathField::keyPressEvent(QKeyEvent* event)
{
    QLineEdit::keyPressEvent(event);
    if (event->key() != Qt::Key_Return && event->key() != Qt::Key_Enter)
        return;
    // Enter is for this field alone; what holds it could close, and the list of proposals would change the text again.
    event->accept();
    _completer->popup()->hide();
    if (!event->isAutoRepeat())
        _onEnter();
}

void PathField::propose()
{
    QString const typed = text();
    try
    {
        QString const start = typed.left(typed.lastIndexOf(QLatin1Char('/')) + 1);
        OsPlace const place = OsPlace::find(toTypedPath(start), _directory);
        _completer->propose(typed, place.name.empty() ? &place.directory : nullptr);
    }
    catch (ExBase const&)
    {
        _completer->propose(typed, nullptr);
    }
}

void PathField::showProposals()
{
    if (hasFocus() && isEdited())
        _completer->complete();
}

std::string PathField::toTypedPath(QString const& text) const
{
    // The bytes behind replacement characters are known where the text begins as it was shown.
    return text.startsWith(_shown) ? _directory + toPath(text.mid(_shown.size())) : toPath(text);
}

} // namespace Kv
