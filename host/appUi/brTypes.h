#pragma once

namespace Kv
{

/// The looks of browsers.
struct BrTypes
{
    enum ViewType
    {
        /// A row an entry, with name, size and time of the last change.
        Details = 0,
    };
};

/// The place where a browser shows the folders.
enum class PaneEnum
{
    /// In the list, ahead of the files; there is no pane for them alone.
    List = 0,
};

/// The memory of a browser for where it has been, for going back.
enum class HistoryEnum
{
    None = 0,
};

/// The time at which a browser shows the place that it is sent to.
enum class UpdateEnum
{
    AtOnce = 0,
};

/// The use of a browser's places as bookmarks.
enum class Bookmarkable
{
    No = 1,
};

} // namespace Kv
