#pragma once

#include <QObject>

#include <atomic>
#include <functional>
#include <memory>
#include <string>

namespace Kv
{

/// Has what asks the file system done in a thread, one thing at a time. The thread holds nothing of the user interface,
/// and nobody waits for it: one that a file system keeps for ever stops neither the window nor the end of the process.
class QtDirWorker final : public QObject
{
public:
    /// Runs in the thread and gives what is to be done with the result, which runs in the thread of this object. Throws
    /// nothing. It can end early once `cancelled` is true.
    using Work = std::function<std::function<void()>(std::atomic<bool> const& cancelled)>;

    QtDirWorker() = default;
    ~QtDirWorker() override;

    /// Takes the place of what is under way, whose result nobody sees any more. `path` is what the work asks for: while
    /// that keeps another thread, the work waits.
    void start(std::string const& path, Work work);

    /// The same; a result that is there within a moment is taken at once.
    void startAndWait(std::string const& path, Work work);

    void cancel();

    bool isBusy() const { return _job != nullptr; }

protected:
    void customEvent(QEvent* event) override;

private:
    struct Job;

    void takeResult();

    std::shared_ptr<Job> _job;
};

} // namespace Kv
