#include "peers/qtTextField.h"

#include "peers/qtLabel.h"
#include "peers/qtText.h"
#include "windows/qtFocusOrder.h"

#include <QKeyEvent>
#include <QMouseEvent>

#include <limits>

namespace Kv
{

namespace
{

class LineEdit final : public QLineEdit
{
public:
    LineEdit(QWidget* parent, QtListenerHandle<NtTextFieldListener> const& handle) : QLineEdit(parent), _handle(handle)
    {
        QtFocusOrder::markAsValue(*this);
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

} // namespace

QtTextField::QtTextField(QWidget* parent, std::string const& name, NtTextFieldListener& listener)
    : QtTextField(parent, name, QtListenerHandle<NtTextFieldListener>(listener))
{
}

QtTextField::QtTextField(QWidget* parent, std::string const& name, QtListenerHandle<NtTextFieldListener> const& handle)
    : QtPeer(makeNative<LineEdit>(parent, handle), name, QtNative::rowInset), _handle(handle)
{
}

QtTextField::~QtTextField()
{
    _handle.close();
}

void QtTextField::setText(std::string const& text, bool cursorAtEnd)
{
    QLineEdit* const field = getNative();
    QString const newText = toQString(text);
    // The same text again would lose the user's selection and undo steps.
    if (!field || field->text() == newText)
        return;
    field->setText(newText);
    field->setCursorPosition(cursorAtEnd ? static_cast<int>(newText.size()) : 0);
}

void QtTextField::setAlign(NtAlign align)
{
    if (QLineEdit* const field = getNative())
        field->setAlignment(toQtAlignment(align));
}

} // namespace Kv
