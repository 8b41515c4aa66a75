#include "ntTextField.h"
#include "peers/qtPeer.h"
#include "peers/qtText.h"
#include "windows/qtFocusOrder.h"

#include <QKeyEvent>
#include <QLineEdit>
#include <QMouseEvent>

#include <limits>

namespace Kv
{

namespace
{

class LineEdit final : public QLineEdit, public QtValueWidget
{
public:
    LineEdit(QWidget* parent, QtListenerHandle<NtTextFieldListener> const& handle) : QLineEdit(parent), _handle(handle)
    {
        setMaxLength(std::numeric_limits<int>::max());
        connect(this, &QLineEdit::textEdited, this, [this] { tellEdited(); });
        connect(this, &QLineEdit::returnPressed, this, [this] { tellEnded(); });
    }

protected:
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
        LineEdit* const field = getNative();
        QString const newText = toQString(text);
        // The same text again would lose the user's selection and undo steps.
        if (!field || field->text() == newText)
            return;
        field->setText(newText);
        field->setCursorPosition(cursorAtEnd ? static_cast<int>(newText.size()) : 0);
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
