#pragma once

#include "files/osFile.h"
#include "kvExport.h"
#include "piGraph.h"

#include <cstdint>
#include <string>

namespace Kv
{

/// All that it takes to have a composition again with its changes that are not saved.
struct PiUnsavedComposition
{
    /// That of the composition's file.
    OsFilePath path;
    /// That of the file as the composition knows it, by `OsFile::getVersion`.
    OsFile::Version version;
    /// The file as a save would write it.
    std::string text;
};

/// A composition as the application sees it: the controller of a graph that is kept in a file.
class KV_API PiCompositionGraphInterface : public virtual PiNodeController
{
public:
    virtual RCShdPtr<const PiGraph> getGraph() const = 0;
    virtual RCShdPtr<PiGraph> getGraph() = 0;

    /// The composition's file: absolute, with symbolic links followed. It may have been deleted.
    virtual OsFilePath const& getPath() const = 0;

    /// True if the file can be written now, which is asked of the disk at each call.
    virtual bool isEditable() const = 0;

    /// True if there are changes that have not been saved.
    virtual bool isModified() const = 0;

    /// Grows with each change.
    virtual std::uint64_t getChangeCount() const = 0;

    virtual PiUnsavedComposition getUnsaved() const = 0;

    /// True if somebody else has written the file since it was opened or saved; false also where the system cannot
    /// tell.
    virtual bool isChangedOnDisk() const = 0;

    /// Writes the file as a whole or not at all. Throws `ExBase`, naming the path, where it cannot be written, and
    /// where it is changed on disk; the file is then as it was.
    virtual void save() = 0;

    /// Writes the file also where it is changed on disk.
    virtual void saveOver() = 0;
};

} // namespace Kv
