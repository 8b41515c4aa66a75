#include "ntTextField.h"
#include "peers/qtLongText.h"
#include "peers/qtPeer.h"
#include "peers/qtText.h"
#include "peers/qtUnseen.h"
#include "windows/qtFocusOrder.h"

#include <QKeyEvent>
#include <QLineEdit>
#include <QMouseEvent>

namespace Kv
{

namespace
{

class LineEdit final : public QLineEdit, public QtValueWidget
{
public:
    LineEdit(QWidget* parent, QtListenerHandle<NtTextFieldListener> const& handle) : QLineEdit(parent), _handle(handle)
    {
        // What the user adds beyond would be cut off the next time.
        setMaxLength(mostShown);
        connect(this, &QLineEdit::textEdited, this, [this] { tellEdited(); });
        connect(this, &QLineEdit::returnPressed, this, [this] { tellEnded(); });
    }

    /// Shows a text. One that is too long for Qt is only looked at: an edit of what is shown would lose the rest.
    void showText(QString const& text, bool cursorAtEnd)
    {
        QtUnseen const unseen(*this);
        QString const shown = toShown(text);
        _size = text.size();
        setReadOnly(shown.size() < _size);
        // The same text again would lose the user's selection and undo steps.
        if (shown == this->text())
            return;
        setText(shown);
        setCursorPosition(cursorAtEnd ? static_cast<int>(shown.size()) : 0);
    }

protected:
    bool event(QEvent* event) override
    {
        if (event->type() == QEvent::ToolTip && isReadOnly())
            return showWhole(*this, *event,
                             QStringLiteral("A text of %1 characters is too long to be edited here.").arg(_size));
        return QLineEdit::event(event);
    }

    void keyPressEvent(QKeyEvent* event) override
    {
        QLineEdit::keyPressEvent(event);
        // Enter is for this field alone; what holds the window could close it.
        if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
            event->accept();
    }

    void mouseReleaseEvent(QMouseEvent* event) override
    {
        QLineEdit::mouseReleaseEvent(event);
        if (event->button() == Qt::LeftButton && rect().contains(event->position().toPoint()))
            tellClicked();
    }

private:
    void tellEdited() const
    {
        if (isVisible())
            _handle.tell(&NtTextFieldListener::onTextEdited, text().toStdString());
    }

    void tellEnded() const
    {
        if (isVisible())
            _handle.tell(&NtTextFieldListener::onEditEnded);
    }

    void tellClicked() const
    {
        if (isVisible())
            _handle.tell(&NtTextFieldListener::onClicked);
    }

    QtListenerHandle<NtTextFieldListener> _handle;
    qsizetype _size = 0;
};

/// A line edit.
class TextField final : public QtPeerOf<NtTextField, LineEdit>
{
public:
    TextField(QWidget* parent, std::string const& name, NtTextField::Listener& listener)
        : QtPeerOf(parent, name, rowInset, listener)
    {
    }

    void setText(std::string const& text, bool cursorAtEnd) override
    {
        if (LineEdit* const field = getNative())
            field->showText(toQString(text), cursorAtEnd);
    }

    void setAlign(NtAlign align) override
    {
        if (LineEdit* const field = getNative())
            field->setAlignment(toQtAlignment(align));
    }
};

QtPeerKind<NtTextField, TextField> registered;

} // namespace

} // namespace Kv
