#pragma once

#include <string>

class QCoreApplication;

namespace Kv
{

/// Qt's application object, which there is once in the process. One that somebody else made is used as it is and stays
/// theirs, whenever it comes; else one of our own is made, which lives as long as the process.
class QtApplication
{
public:
    QtApplication();

    /// True if widgets that were made can still be touched.
    static bool isThere();

    /// True if fonts and screens can be asked and widgets made.
    bool hasGui();

    /// True if the application object is our own.
    bool isOwn() const;

    /// Throws an `ExBase` that says why and what to do where events cannot be dispatched.
    void requireLoop();

    /// Throws an `ExBase` that says why and what to do where windows cannot be shown.
    void requireWindows();

private:
    void start();
    void makeOwn();
    std::string getRefusal() const;

    /// Ours, or null; never destroyed.
    QCoreApplication* _own = nullptr;

    /// The reason why our own application cannot show windows, or was not even made.
    std::string _refusal;
    bool _tried = false;
};

} // namespace Kv
