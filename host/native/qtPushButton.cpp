#include "native/qtPushButton.h"

#include "native/qtText.h"

#include <QKeyEvent>

namespace Kv
{

namespace
{

class PushButton final : public QPushButton
{
public:
    PushButton(QWidget* parent, QtListenerHandle<NtPushButtonListener> const& handle)
        : QPushButton(parent), _handle(handle)
    {
        setFocusPolicy(Qt::StrongFocus);
        setAutoDefault(true);
        connect(this, &QPushButton::clicked, this, [this] { tellPressed(); });
    }

protected:
    void keyPressEvent(QKeyEvent* event) override
    {
        // A key that is held down presses once: what the button opens must not be pressed away again.
        if (event->isAutoRepeat() && (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter))
            event->accept();
        else
            QPushButton::keyPressEvent(event);
    }

private:
    void tellPressed() const
    {
        if (isVisible())
            _handle.tell(&NtPushButtonListener::onPressed);
    }

    QtListenerHandle<NtPushButtonListener> _handle;
};

} // namespace

QtPushButton::QtPushButton(QWidget* parent, std::string const& name, NtPushButtonListener& listener)
    : QtPushButton(parent, name, QtListenerHandle<NtPushButtonListener>(listener))
{
}

QtPushButton::QtPushButton(QWidget* parent, std::string const& name,
                           QtListenerHandle<NtPushButtonListener> const& handle)
    : QtPeer(makeNative<PushButton>(parent, handle), name, QtNative::rowInset), _handle(handle)
{
}

QtPushButton::~QtPushButton()
{
    _handle.close();
}

void QtPushButton::setText(std::string const& text)
{
    // A lone ampersand would become the mark of a shortcut.
    if (QPushButton* const button = getNative())
        button->setText(toQString(text).replace(QLatin1Char('&'), QLatin1String("&&")));
}

} // namespace Kv
