// A power cut at each moment of a save. What was synced is on the disk then. Of what was not, a file's content is lost,
// and a name leads where it did or where it was to.

#include "files/osFile.h"

#include <algorithm>
#include <cstdio>
#include <dlfcn.h>
#include <filesystem>
#include <fstream>
#include <functional>
#include <gtest/gtest.h>
#include <iterator>
#include <map>
#include <set>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

using namespace Kv;

namespace fs = std::filesystem;

namespace
{

std::function<void()> onCall;
std::function<void(int)> onSynced;

template <typename Function> Function* getReal(Function*, char const* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

std::string read(fs::path const& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

class PowerCut : public testing::Test
{
protected:
    PowerCut()
    {
        std::string pattern = fs::temp_directory_path() / "powerCutXXXXXX";
        folder = mkdtemp(pattern.data());
        file = folder / "shot";
        onCall = [this] { cut(); };
        onSynced = [this](int descriptor) { takeSynced(descriptor); };
    }

    ~PowerCut() override
    {
        onCall = nullptr;
        onSynced = nullptr;
        fs::remove_all(folder);
    }

    /// The file as it was long ago.
    void makeOld(std::string const& content)
    {
        std::ofstream(file, std::ios::binary) << content;
        name = findFile();
        contents[name] = content;
    }

    void save(fs::path const& path, std::string const& content)
    {
        OsFile(OsFilePath(path.string())).replace(content);
        // What the save has promised by now holds in any case.
        EXPECT_EQ(findLeft(), std::set<std::string>{content});
    }

    fs::path folder;
    fs::path file;
    /// What cuts at all moments leave in the file.
    std::set<std::string> left;

private:
    /// The number of the file that the name leads to; 0 if there is none.
    ino_t findFile() const
    {
        struct stat status = {};
        return stat(file.c_str(), &status) == 0 ? status.st_ino : 0;
    }

    void takeSynced(int descriptor)
    {
        struct stat status = {};
        struct stat ours = {};
        ASSERT_EQ(fstat(descriptor, &status), 0);
        ASSERT_EQ(stat(folder.c_str(), &ours), 0);
        if (S_ISREG(status.st_mode))
            contents[status.st_ino] = read("/proc/self/fd/" + std::to_string(descriptor));
        else if (status.st_ino == ours.st_ino)
            name = findFile();
    }

    std::set<std::string> findLeft() const
    {
        std::set<std::string> found;
        for (ino_t const number : {name, findFile()})
            found.insert(number == 0 ? "no file" : contents.count(number) > 0 ? contents.at(number) : "half a file");
        return found;
    }

    void cut() { left.merge(findLeft()); }

    /// By its number, what of a file is on the disk for sure.
    std::map<ino_t, std::string> contents;
    /// The number of the file that its name leads to on the disk for sure.
    ino_t name = 0;
};

TEST_F(PowerCut, LeavesTheOldFileOrTheNewOne)
{
    std::string const old(100000, 'o');
    std::string const changed(200000, 'n');
    makeOld(old);
    save(file, changed);
    EXPECT_EQ(left, (std::set<std::string>{old, changed}));
    fs::create_directory(folder / "elsewhere");
    fs::create_symlink(file, folder / "elsewhere" / "link");
    save(folder / "elsewhere" / "link", "third");
    EXPECT_EQ(left, (std::set<std::string>{old, changed, "third"}));
}

TEST_F(PowerCut, LeavesTheFirstFileOrNone)
{
    save(file, "first");
    EXPECT_EQ(left, (std::set<std::string>{"no file", "first"}));
}

} // namespace

// What the library calls is found here first.

extern "C" __attribute__((visibility("default"))) int fsync(int descriptor)
{
    static auto* const real = getReal(&fsync, "fsync");
    if (onCall)
        onCall();
    int const result = real(descriptor);
    if (result == 0 && onSynced)
        onSynced(descriptor);
    return result;
}

extern "C" __attribute__((visibility("default"))) int rename(char const* path, char const* target)
{
    static auto* const real = getReal(&rename, "rename");
    if (onCall)
        onCall();
    int const result = real(path, target);
    if (onCall)
        onCall();
    return result;
}
