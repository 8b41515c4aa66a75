#pragma once

#include "files/osFile.h"
#include "files/osFilePath.h"

#include <string>
#include <sys/stat.h>

namespace Kv
{

/// A new file beside the one that it is to become; it goes with this object unless it has become that. Every operation
/// throws `std::system_error` where the system refuses it.
class OsTemporaryFile
{
public:
    /// Makes an empty file, with the permissions of any new file, in `folder`.
    explicit OsTemporaryFile(OsFilePath const& folder);
    OsTemporaryFile(OsTemporaryFile const&) = delete;
    OsTemporaryFile& operator=(OsTemporaryFile const&) = delete;
    ~OsTemporaryFile();

    void write(std::string const& content);

    /// The owner is changed where the system allows it; the permissions always.
    void takeOwnerAndPermissions(struct stat const& other);

    /// Puts the file in the place of `target`, once its content is on the disk.
    void moveTo(OsFilePath const& target);

private:
    static int create(std::string& path);

    /// Empty once the file has its place.
    std::string _path;
    OsFileDescriptor _descriptor;
};

} // namespace Kv
