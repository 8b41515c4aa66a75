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
    PushButton(QWidget* parent, QtEar<NtPushButtonListener> const& ear) : QPushButton(parent), _ear(ear)
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
            _ear.tell(&NtPushButtonListener::onPressed);
    }

    QtEar<NtPushButtonListener> _ear;
};

} // namespace

QtPushButton::QtPushButton(QWidget* parent, std::string const& name, NtPushButtonListener& listener)
    : QtPushButton(parent, name, QtEar<NtPushButtonListener>(listener))
{
}

QtPushButton::QtPushButton(QWidget* parent, std::string const& name, QtEar<NtPushButtonListener> const& ear)
    : QtPeer(makeNative<PushButton>(parent, ear), name, QtNative::rowInset), _ear(ear)
{
}

QtPushButton::~QtPushButton()
{
    _ear.close();
}

void QtPushButton::setText(std::string const& text)
{
    // A lone ampersand would become the mark of a shortcut.
    if (QPushButton* const button = getNative())
        button->setText(toQString(text).replace(QLatin1Char('&'), QLatin1String("&&")));
}

} // namespace Kv
