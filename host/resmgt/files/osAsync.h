#pragma once

#include "kvExport.h"

#include <atomic>
#include <chrono>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <string>

namespace Kv
{

/// Asks the file system in threads that nobody waits for longer than a moment, not even the end of the process: a
/// network's in its bad hour answers minutes later. Of two works on one path the second waits for the first, what is
/// below a path that is silent waits for that, and no more than a few dozen are under way at once: however often
/// somebody asks, few threads hang.
class KV_API OsAsync
{
public:
    /// Work that has not begun by the time that it is true never begins.
    using Cancelled = std::shared_ptr<std::atomic<bool> const>;

    /// The time for which somebody who has to have an answer at once waits for it.
    static constexpr std::chrono::milliseconds patience{300};

    /// That of a start or an end, which may take longer than a moment, but not for ever.
    static constexpr std::chrono::seconds longPatience{2};

    /// Does `work`, which throws nothing, in a thread. `path` is what it asks for: an absolute path, that of
    /// `getEntries`, or an empty one for work that asks for none.
    static void start(std::string const& path, std::function<void()> work, Cancelled const& cancelled);

    /// What work asks for that asks for the entries of a directory: one of them can hang while the directory answers.
    static std::string getEntries(std::string const& directory) { return directory + "/*"; }

    /// True if work on the path, or above it, has been under way for longer than one waits.
    static bool isSilent(std::string const& path);

    /// The answer to a question about a path; nothing where it does not come in time. Throws what the question throws.
    template <typename Question>
    static std::optional<std::invoke_result_t<Question>> ask(std::string const& path, Question question)
    {
        if (isSilent(path))
            return std::nullopt;
        auto const cancelled = std::make_shared<std::atomic<bool>>(false);
        auto answer = startTask(path, std::move(question), cancelled);
        if (answer.wait_for(patience) == std::future_status::ready)
            return answer.get();
        *cancelled = true;
        return std::nullopt;
    }

    /// Has work done however late, after all that was entrusted before for the path, and gives its outcome. Whoever
    /// lets go of that does not wait either.
    template <typename Work> static std::future<std::invoke_result_t<Work>> entrust(std::string const& path, Work work)
    {
        return startTask(path, std::move(work), std::make_shared<std::atomic<bool>>(false));
    }

    /// Waits for such an outcome, though no longer than somebody who has to have an answer at once. True if it is
    /// there.
    template <typename Outcome> static bool comes(std::string const& path, Outcome const& outcome)
    {
        std::chrono::milliseconds const rest = isSilent(path) ? std::chrono::milliseconds(0) : patience;
        return outcome.wait_for(rest) == std::future_status::ready;
    }

private:
    template <typename Work>
    static std::future<std::invoke_result_t<Work>> startTask(std::string const& path, Work work,
                                                             Cancelled const& cancelled)
    {
        auto const task = std::make_shared<std::packaged_task<std::invoke_result_t<Work>()>>(std::move(work));
        auto outcome = task->get_future();
        start(
            path, [task] { (*task)(); }, cancelled);
        return outcome;
    }
};

} // namespace Kv
