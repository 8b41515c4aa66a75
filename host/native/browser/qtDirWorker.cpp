#include "browser/qtDirWorker.h"

#include "files/osAsync.h"

#include <QCoreApplication>
#include <QEvent>

#include <condition_variable>
#include <exception>
#include <mutex>
#include <utility>

namespace Kv
{

/// The data that the two threads share.
struct QtDirWorker::Job
{
    std::atomic<bool> cancelled = false;
    /// Guards what follows.
    std::mutex mutex;
    std::condition_variable ended;
    /// Null once nobody wants the result.
    QtDirWorker* owner = nullptr;
    /// Null until the work has ended.
    std::function<void()> result;
};

QtDirWorker::~QtDirWorker()
{
    cancel();
}

void QtDirWorker::start(std::string const& path, Work work)
{
    cancel();
    _job = std::make_shared<Job>();
    _job->owner = this;
    auto const run = [job = _job, work = std::move(work)]
    {
        std::function<void()> result;
        try
        {
            result = work(job->cancelled);
        }
        catch (...)
        {
            // Thrown where the work was asked for.
            result = [error = std::current_exception()] { std::rethrow_exception(error); };
        }
        std::lock_guard<std::mutex> const lock(job->mutex);
        if (!job->owner)
            return;
        job->result = std::move(result);
        job->ended.notify_all();
        QCoreApplication::postEvent(job->owner, new QEvent(QEvent::User));
    };
    OsAsync::start(path, run, std::shared_ptr<std::atomic<bool> const>(_job, &_job->cancelled));
}

void QtDirWorker::startAndWait(std::string const& path, Work work)
{
    bool const isSilent = OsAsync::isSilent(path);
    start(path, std::move(work));
    if (isSilent)
        return;
    {
        std::unique_lock<std::mutex> lock(_job->mutex);
        _job->ended.wait_for(lock, OsAsync::patience, [job = _job.get()] { return job->result != nullptr; });
    }
    takeResult();
}

void QtDirWorker::cancel()
{
    std::shared_ptr<Job> const job = std::exchange(_job, nullptr);
    if (!job)
        return;
    job->cancelled = true;
    std::lock_guard<std::mutex> const lock(job->mutex);
    job->owner = nullptr;
}

void QtDirWorker::customEvent(QEvent*)
{
    takeResult();
}

void QtDirWorker::takeResult()
{
    if (!_job)
        return;
    std::function<void()> result;
    {
        std::lock_guard<std::mutex> const lock(_job->mutex);
        result = std::exchange(_job->result, nullptr);
    }
    if (!result)
        return;
    _job.reset();
    result();
}

} // namespace Kv
