#pragma once

#include "iterator.h"
#include "prdPredicate.h"
#include "uiWidget.h"

#include <string>
#include <unordered_map>
#include <vector>

namespace Kv
{

/// Widget that holds others, lays them out by their constraints and finds them by name.
class KV_API UiContainer : public UiWidget
{
public:
    /// A container at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiContainer> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    ~UiContainer() override;

    UiWindow* getWindow() const override;

    /// The rectangle that the widgets in it are laid out in, in pixels of the window.
    virtual GeRectangle<int> getFrame() const { return getRect(); }

    void show() override;

    /// The widgets directly in it, in order of creation. To be read in place.
    std::vector<RCShdPtr<UiWidget>> const& getChildren() const;

    /// The descendant of that name, the first of several from front to back and depth first; null if there is none.
    RCShdPtr<UiWidget> findWidget(LiString const& name) const;

    /// All descendants that satisfy the predicate, from front to back and depth first.
    Iterator<RCShdPtr<UiWidget>> findWidgets(PrdPredicate<UiWidget> const& predicate) const;

    /// Puts a descendant above its siblings on the screen.
    void front(RCShdPtr<UiWidget> const& descendant);

    /// Gives a descendant the keyboard, if it can have it.
    void setFocusWidget(RCShdPtr<UiWidget> const& descendant);

    /// Gives the keyboard to the first widget in it that holds a value, without one to the first push button.
    void focusFirst();

    /// Takes `child` as the last of the widgets in it.
    void addChild(RCShdPtr<UiWidget> const& child);

protected:
    explicit UiContainer(std::string name);

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) override;
    void dropPeer() override;

    bool takesInput() const override;
    void takeRect(GeRectangle<int> const& rect, bool layOut) override;
    void placePeers() override;

    /// Makes the peers of the widgets in it inside `native`, which is borrowed.
    void attachNative(NtPlatform& platform, NtContainer& native);

    /// Works out the places of the widgets in it from their constraints, all the way down.
    virtual void layOutChildren();

private:
    friend class UiWidget;
    friend class UiTopLevel;

    void forgetHandlers() override;
    void removeChild(UiWidget* child);
    void forgetNames();
    void collect(PrdPredicate<UiWidget> const& predicate, std::vector<RCShdPtr<UiWidget>>& found) const;
    void indexDescendants(std::unordered_map<std::string, UiWidget*>& index) const;

    std::vector<RCShdPtr<UiWidget>> _children;
    UiWindow* _window = nullptr;
    NtContainer* _native = nullptr;

    /// The descendants by name; filled by the first search after a change of the tree.
    mutable std::unordered_map<std::string, UiWidget*> _names;
    mutable bool _namesKnown = false;
};

} // namespace Kv
