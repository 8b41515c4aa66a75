#include <boost/python.hpp>

#include "pyUtils.h"

#include "files/osFile.h"
#include "pyUiError.h"

#include <cstdio>
#include <memory>
#include <vector>

namespace Kv::PyextUi
{

namespace
{

struct FileCloser
{
    void operator()(std::FILE* file) const
    {
        OsFile::FileDescriptorManipGuard const guard;
        static_cast<void>(std::fclose(file));
    }
};

using FilePtr = std::unique_ptr<std::FILE, FileCloser>;

FilePtr openFile(OsFilePath const& path)
{
    OsFile::FileDescriptorManipGuard const guard;
    return FilePtr(std::fopen(path.getChars(), "r"));
}

} // namespace

std::string readDescriptionFile(OsFilePath const& path)
{
    FilePtr file = openFile(path);
    if (!file)
        throw UiError(__FILE__, __LINE__, (std::string("Error opening file: ") + path.getChars()).c_str());
    std::uint64_t const size = OsFile(path).getSize();
    std::vector<char> text(size + 1);
    std::size_t const count = std::fread(text.data(), 1, size, file.get());
    text[count] = 0;
    file.reset();
    return text.data();
}

int lengthOf(boost::python::object const& sequence)
{
    return boost::python::extract<int>(sequence.attr("__len__")());
}

} // namespace Kv::PyextUi
