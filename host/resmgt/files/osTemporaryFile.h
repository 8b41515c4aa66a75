#pragma once

#include "files/osFile.h"
#include "files/osFilePath.h"

#include <string>
#include <sys/stat.h>

namespace Kv
{

/// A new file beside the one that it is to become; it goes with this object unless it has become that. It is locked, so
/// that one whose process was killed is known by its lock being free: the next file that this machine makes in the
/// folder removes it. Every operation throws `std::system_error` where the system refuses it.
class OsTemporaryFile
{
public:
    /// The permissions of any new file.
    static constexpr mode_t anyFile = S_IRUSR | S_IWUSR | S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;

    /// Makes an empty file in `folder`, with these permissions as far as the process gives them.
    explicit OsTemporaryFile(OsFilePath const& folder, mode_t permissions = anyFile);
    OsTemporaryFile(OsTemporaryFile const&) = delete;
    OsTemporaryFile& operator=(OsTemporaryFile const&) = delete;
    ~OsTemporaryFile();

    void write(std::string const& content);

    /// The owner is changed where the system allows it; the permissions always.
    void takeOwnerAndPermissions(struct stat const& other);

    /// Puts the content on the disk. Gives what the file is then.
    struct stat sync();

    /// Puts the file, once that is done, in the place of `target`, and then the folder on the disk too. Gives the
    /// descriptor, which keeps the file locked.
    OsFileDescriptor moveTo(OsFilePath const& target);

private:
    static OsFileDescriptor create(std::string& path, mode_t permissions);

    /// Empty once the file has its place.
    std::string _path;
    OsFileDescriptor _descriptor;
};

} // namespace Kv
