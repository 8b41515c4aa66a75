#pragma once

#include <QWidget>

namespace Kv
{

/// A peer that other peers' widgets can stand in.
class QtHolder
{
public:
    QtHolder() = default;
    QtHolder(QtHolder const&) = delete;
    QtHolder& operator=(QtHolder const&) = delete;
    virtual ~QtHolder() = default;

    /// The native parent of what stands in it, borrowed; null when it is gone.
    virtual QWidget* getContent() const = 0;

protected:
    /// Gives the keyboard to the first widget in the content that holds a value, without one to the first push button.
    void focusFirstInContent() const;
};

} // namespace Kv
