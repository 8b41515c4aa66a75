#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>

/// What libFuzzer calls with each input; it gives 0.
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size);

/// What the programs share that libFuzzer feeds.
namespace Kv::Fuzz
{

inline std::string_view asText(std::uint8_t const* data, std::size_t size)
{
    return {reinterpret_cast<char const*>(data), size};
}

/// Ends the process, as a finding, where something does not hold.
inline void require(bool holds, char const* what)
{
    if (holds)
        return;
    std::fprintf(stderr, "does not hold: %s\n", what);
    std::abort();
}

/// A folder of the process's own, in memory; it goes when the process ends well.
class Folder
{
public:
    Folder()
    {
        std::string name = "/dev/shm/velmora-fuzz-XXXXXX";
        require(mkdtemp(name.data()) != nullptr, "there is room in memory");
        _path = name;
    }
    Folder(Folder const&) = delete;
    Folder& operator=(Folder const&) = delete;
    ~Folder()
    {
        std::error_code ignored;
        std::filesystem::remove_all(_path, ignored);
    }

    std::filesystem::path const& getPath() const { return _path; }

    /// The path of a file with that content.
    std::filesystem::path write(std::string const& name, std::string_view content) const
    {
        std::filesystem::path path = _path / name;
        std::ofstream(path, std::ios::binary) << content;
        return path;
    }

private:
    std::filesystem::path _path;
};

} // namespace Kv::Fuzz
