#pragma once

#include "ntPeer.h"
#include "peers/qtListenerHandle.h"

#include <QPointer>
#include <QWidget>

#include <memory>
#include <string>
#include <type_traits>
#include <typeindex>

namespace Kv
{

class QtPointerWatch;

/// Base of the peers: what all kinds share. Owns the native widget together with the widget's native parent: whichever
/// goes first takes it along, so it can be gone at any time, and then the peer does nothing. A widget of the
/// application's is borrowed.
class QtPeer : public virtual NtPeer
{
public:
    ~QtPeer() override;

    void setCell(int x, int y, int width, int height) override;
    void setDisplayed(bool displayed) override;
    void setEnabled(bool enabled) override;
    void setTooltip(std::string const& text) override;
    void raise() override;
    void setBackground(NtColor const& color) override;
    void setLineBelow(bool drawn) override;
    void setPointerListener(NtPointerListener& listener) override;
    void takeKeyboard() override;
    bool hasKeyboard() const override;
    bool holdsValue() const override;

    /// Borrowed; null when the widget is gone.
    QWidget* getNative() const;

    /// The native parent of the peers that stand in this one, borrowed; null when it is gone.
    virtual QWidget* getContent() const { return getNative(); }

protected:
    /// Room above and below a widget that keeps rows which touch from looking glued together.
    static constexpr int rowInset = 2;

    /// `widget` can be null. It gets the name, is displayed and has no cell yet. `inset` is left free above and below
    /// in the cell, where the widget is not too high for that.
    QtPeer(std::unique_ptr<QWidget> widget, std::string const& name, int inset);

    /// A widget of the application's, which keeps its name and its place.
    explicit QtPeer(NtForeignWidget widget);

    /// Gives the keyboard to the first widget in the content that holds a value, without one to the first push button.
    void focusFirstInContent() const;

private:
    /// Owns the widget from here on, also where the construction goes on and fails.
    QtPeer(std::unique_ptr<QWidget> widget, int inset);

    QPointer<QWidget> _widget;
    int _inset = 0;
    bool _foreign = false;
    std::unique_ptr<QtPointerWatch> _pointerWatch;
    QPointer<QWidget> _line;
};

/// Peer with the face `Face`, behind which stands Qt's or our class `Widget`. That is made in the native parent, which
/// owns it, and has a copy of the handle if the face has a listener. Without a parent there is no widget.
template <typename Face, typename Widget> class QtPeerOf : public Face, public QtPeer
{
public:
    using Handle = QtListenerHandle<typename Face::Listener>;

    ~QtPeerOf() override { _handle.close(); }

    /// Borrowed; null when the widget is gone.
    Widget* getNative() const { return static_cast<Widget*>(QtPeer::getNative()); }

protected:
    /// The listener is borrowed.
    QtPeerOf(QWidget* parent, std::string const& name, int inset, typename Face::Listener& listener)
        : QtPeerOf(parent, name, inset, Handle(listener))
    {
    }

private:
    QtPeerOf(QWidget* parent, std::string const& name, int inset, Handle const& handle)
        : QtPeer(parent ? makeWidget(parent, handle) : nullptr, name, inset), _handle(handle)
    {
    }

    static std::unique_ptr<QWidget> makeWidget(QWidget* parent, Handle const& handle)
    {
        if constexpr (std::is_same_v<typename Face::Listener, NtNoListener>)
            return std::make_unique<Widget>(parent);
        else
            return std::make_unique<Widget>(parent, handle);
    }

    Handle _handle;
};

/// The kinds of peers that can be made, by their faces.
class QtPeerKinds
{
public:
    using Make = std::unique_ptr<NtPeer> (*)(QWidget* parent, std::string const& name, void* listener);

    /// One kind. They are a list, each in the static object that makes it known: what a library does while it is loaded
    /// must not need memory.
    struct Kind
    {
        std::type_index face;
        Make make;
        Kind const* next = nullptr;
    };

    /// Borrowed for ever.
    static void add(Kind& kind);

    /// `listener` is a `Listener` of the face. Throws a `std::logic_error` for a face that no kind has.
    static std::unique_ptr<NtPeer> make(std::type_index face, QWidget* parent, std::string const& name, void* listener);
};

/// Makes the peers of one kind known. Each kind has one in its own source file.
template <typename Face, typename Peer> class QtPeerKind
{
public:
    QtPeerKind() { QtPeerKinds::add(_kind); }

private:
    static std::unique_ptr<NtPeer> make(QWidget* parent, std::string const& name, void* listener)
    {
        return std::make_unique<Peer>(parent, name, *static_cast<typename Face::Listener*>(listener));
    }

    QtPeerKinds::Kind _kind{typeid(Face), &make};
};

} // namespace Kv
