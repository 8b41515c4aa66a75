#include "ntPushButton.h"
#include "peers/qtLongText.h"
#include "peers/qtPeer.h"
#include "peers/qtText.h"

#include <QKeyEvent>
#include <QPushButton>
#include <QStyleOptionButton>
#include <QStylePainter>

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

    void setWords(QString const& words)
    {
        _words = words;
        setText(withoutShortcuts(toShown(words)));
    }

    void setAlign(NtAlign align)
    {
        _align = align;
        update();
    }

protected:
    bool event(QEvent* event) override
    {
        if (event->type() == QEvent::ToolTip && getLines().isCut)
            return showWhole(*this, *event, _words);
        return QPushButton::event(event);
    }

    void paintEvent(QPaintEvent*) override
    {
        QStylePainter painter(this);
        QStyleOptionButton option;
        initStyleOption(&option);
        option.text.clear();
        painter.drawControl(QStyle::CE_PushButton, option);
        painter.drawItemText(getRoom(), static_cast<int>(toQtAlignment(_align)), palette(), isEnabled(),
                             getLines().lines.join(QLatin1Char('\n')), QPalette::ButtonText);
    }

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

    QRect getRoom() const
    {
        QStyleOptionButton option;
        initStyleOption(&option);
        QRect const room = style()->subElementRect(QStyle::SE_PushButtonContents, &option, this);
        // The edge of the button is none for a text to begin at.
        constexpr int indent = 6;
        return _align == NtAlign::Left ? room.adjusted(indent, 0, 0, 0) : room;
    }

    TextLines getLines() const { return breakIntoLines(_words, font(), getRoom().size()); }

    QtListenerHandle<NtPushButtonListener> _handle;
    QString _words;
    NtAlign _align = NtAlign::Center;
};

/// A push button whose text breaks into lines.
class PushButtonPeer final : public QtPeerOf<NtPushButton, PushButton>
{
public:
    PushButtonPeer(QWidget* parent, std::string const& name, NtPushButton::Listener& listener)
        : QtPeerOf(parent, name, rowInset, listener)
    {
    }

    void setText(std::string const& text) override
    {
        if (PushButton* const button = getNative())
            button->setWords(toQString(text));
    }

    void setAlign(NtAlign align) override
    {
        if (PushButton* const button = getNative())
            button->setAlign(align);
    }
};

QtPeerKind<NtPushButton, PushButtonPeer> registered;

} // namespace

} // namespace Kv
