#pragma once

#include "ntMenu.h"
#include "uiPeeredWidget.h"

#include <string>
#include <vector>

namespace Kv
{

/// A choice among strings. Raises `ValueChanged` when the selection changes, and `Activate` when the user picks.
class KV_API UiMenu : public UiPeeredWidget<NtMenu>
{
public:
    /// A menu at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiMenu> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// The selected entry, UTF-8, valid until the entries change; null while none is selected.
    char const* getStrPtr() const;

    /// Takes all entries away, and the selection with them.
    void removeAll();

    /// Adds an entry at the end; the selection stays. Throws an `ExBase` for a text that is no UTF-8.
    void append(char const* entry);

    /// Selects the entry of that index, 0 being the first; an index outside the entries selects nothing. With `notify`
    /// the handlers of `ValueChanged` run, also when the selection stays the same.
    void setSelection(int index, bool notify);

    /// Places the text in the widget from left to right.
    void setAlign(NtAlign align);

protected:
    explicit UiMenu(std::string name);

private:
    void showState(NtMenu& peer) override;
    void onPicked(int index) override;

    std::vector<std::string> _entries;
    /// -1 while nothing is selected.
    int _selection = -1;
    NtAlign _align = NtAlign::Left;
};

} // namespace Kv
