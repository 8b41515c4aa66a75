#pragma once

namespace Kv
{

/// How browsers look.
struct BrTypes
{
    enum ViewType
    {
        /// A row an entry, with name, size and time of the last change.
        Details = 0,
    };
};

/// Where a browser shows the folders.
enum class PaneEnum
{
    /// In the list, ahead of the files; there is no pane for them alone.
    List = 0,
};

/// Whether a browser remembers where it has been, for going back.
enum class HistoryEnum
{
    None = 0,
};

/// When a browser shows the place that it is sent to.
enum class UpdateEnum
{
    AtOnce = 0,
};

/// Whether places of a browser can be kept as bookmarks.
enum class Bookmarkable
{
    No = 1,
};

} // namespace Kv
