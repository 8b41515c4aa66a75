#include "browser/qtDirWorker.h"

#include <csignal>
#include <exception>
#include <mutex>
#include <system_error>
#include <thread>
#include <utility>

namespace Kv
{

/// The data that the two threads share.
struct QtDirWorker::Job
{
    std::atomic<bool> cancelled = false;
    /// Guards `owner`, which is null once nobody wants the result.
    std::mutex mutex;
    QtDirWorker* owner = nullptr;
};

namespace
{

/// Keeps the signals of the process from threads that are started meanwhile: the interpreter waits for them in its own.
class SignalsBlocked
{
public:
    SignalsBlocked()
    {
        sigset_t all;
        sigfillset(&all);
        pthread_sigmask(SIG_SETMASK, &all, &_before);
    }
    SignalsBlocked(SignalsBlocked const&) = delete;
    SignalsBlocked& operator=(SignalsBlocked const&) = delete;
    ~SignalsBlocked() { pthread_sigmask(SIG_SETMASK, &_before, nullptr); }

private:
    sigset_t _before{};
};

} // namespace

QtDirWorker::~QtDirWorker()
{
    cancel();
}

void QtDirWorker::start(Work work)
{
    cancel();
    _job = std::make_shared<Job>();
    _job->owner = this;
    auto const run = [job = _job, work = std::move(work)]
    {
        std::function<void()> finish;
        try
        {
            finish = work(job->cancelled);
        }
        catch (...)
        {
            // Thrown where the work was asked for.
            finish = [error = std::current_exception()] { std::rethrow_exception(error); };
        }
        std::lock_guard const lock(job->mutex);
        if (job->owner)
            QMetaObject::invokeMethod(
                job->owner,
                [job, finish]
                {
                    if (job->cancelled)
                        return;
                    job->owner->_job.reset();
                    finish();
                },
                Qt::QueuedConnection);
    };
    try
    {
        SignalsBlocked const blocked;
        std::thread(
            [run]
            {
                try
                {
                    run();
                }
                catch (...) // NOLINT(bugprone-empty-catch)
                {
                    // Without the memory to tell of it, there is nothing left but not to end the process.
                }
            })
            .detach();
    }
    catch (std::system_error const&)
    {
        // No thread is to be had: it takes as long as it takes.
        run();
    }
}

void QtDirWorker::cancel()
{
    std::shared_ptr<Job> const job = std::exchange(_job, nullptr);
    if (!job)
        return;
    job->cancelled = true;
    std::lock_guard const lock(job->mutex);
    job->owner = nullptr;
}

} // namespace Kv
