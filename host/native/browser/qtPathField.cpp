#include "browser/qtPathField.h"

#include "browser/qtPathCompleter.h"
#include "files/osPlace.h"
#include "peers/qtText.h"

#include <QAbstractItemView>
#include <QKeyEvent>

#include <utility>

namespace Kv
{

QtPathField::QtPathField(QWidget* parent, std::function<void()> onEnter)
    : QLineEdit(parent), _onEnter(std::move(onEnter)),
      _completer(new QtPathCompleter(this, [this] { showProposals(); }))
{
    setCompleter(_completer);
    connect(this, &QLineEdit::textEdited, this, [this] { propose(); });
}

void QtPathField::setDirectory(std::string const& directory)
{
    _directory = directory;
    _shown = toShownPath(directory);
    setText(_shown);
}

bool QtPathField::isEdited() const
{
    return text() != _shown;
}

std::string QtPathField::getTypedPath() const
{
    return toTypedPath(text());
}

void QtPathField::keyPressEvent(QKeyEvent* event)
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

void QtPathField::propose()
{
    QString const start = text().left(text().lastIndexOf(QLatin1Char('/')) + 1);
    _completer->propose(text(), OsPlace::complete(toTypedPath(start), _directory));
}

void QtPathField::showProposals()
{
    if (hasFocus() && isEdited())
        _completer->complete();
}

std::string QtPathField::toTypedPath(QString const& text) const
{
    // The bytes behind replacement characters are known where the text begins as it was shown.
    return text.startsWith(_shown) ? _directory + toPath(text.mid(_shown.size())) : toPath(text);
}

} // namespace Kv
