#pragma once

#include <QObject>

#include <atomic>
#include <functional>
#include <memory>

namespace Kv
{

/// Does what takes long in a thread of its own, one thing at a time. The thread holds nothing of the user interface,
/// and nobody waits for it: one that a file system keeps for ever stops neither the window nor the end of the process.
class QtDirWorker final : public QObject
{
public:
    /// Runs in the thread and gives what is to be done with the result, which runs in the thread of this object. Throws
    /// nothing. It can end early once `cancelled` is true.
    using Work = std::function<std::function<void()>(std::atomic<bool> const& cancelled)>;

    QtDirWorker() = default;
    ~QtDirWorker() override;

    /// Takes the place of what is under way, whose result nobody sees any more.
    void start(Work work);

    void cancel();

    bool isBusy() const { return _job != nullptr; }

private:
    struct Job;

    std::shared_ptr<Job> _job;
};

} // namespace Kv
