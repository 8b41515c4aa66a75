// Paths that are asked for and typed, and names in a directory that is shown. The lines of the input are paths and
// names; in a name, which has no slash, one is no part of it but stands for the end of a folder's.

#include "fuzz.h"
#include "window.h"

#include "brBrowser.h"
#include "browser/qtDirListing.h"
#include "exBase.h"
#include "files/osPlace.h"
#include "snSelection.h"

#include <QApplication>
#include <QKeyEvent>
#include <QLineEdit>
#include <QTreeView>

#include <algorithm>
#include <chrono>
#include <functional>
#include <set>
#include <string>
#include <vector>

using namespace Kv;
namespace fs = std::filesystem;

namespace
{

/// More would show what fewer do, and take longer: each is typed, and its proposals are read.
constexpr std::size_t mostLines = 12;

std::vector<std::string> split(std::string_view text)
{
    std::vector<std::string> lines;
    for (std::size_t begin = 0; begin <= text.size() && lines.size() < mostLines;)
    {
        std::size_t const end = std::min(text.find('\n', begin), text.size());
        lines.emplace_back(text.substr(begin, end - begin));
        begin = end + 1;
    }
    return lines;
}

/// A new, empty folder with those of the names in it that the file system takes. Gives the names of what is there.
std::set<std::string> makeEntries(fs::path const& folder, std::vector<std::string> const& names)
{
    fs::remove_all(folder);
    fs::create_directory(folder);
    for (std::string const& name : names)
    {
        bool const isFolder = !name.empty() && name.back() == '/';
        std::string const bare = name.substr(0, name.size() - (isFolder ? 1 : 0));
        if (bare.find('/') != std::string::npos || bare.find('\0') != std::string::npos)
            continue;
        std::error_code ignored;
        if (isFolder)
            fs::create_directory(folder / bare, ignored);
        else if (!fs::exists(folder / bare, ignored))
            std::ofstream(folder / bare) << 'x';
    }
    std::set<std::string> present;
    for (fs::directory_entry const& entry : fs::directory_iterator(folder))
        present.insert(entry.path().filename().string());
    return present;
}

void requireListing(fs::path const& folder, std::set<std::string> const& names, bool collapsed)
{
    QtDirListing::Options options;
    options.showsHidden = true;
    if (collapsed)
        options.collapses = [](std::string const&) { return true; };
    QtDirListing const listing(folder, options, false);
    std::size_t files = 0;
    std::set<std::string> listed;
    for (QtDirEntry const& entry : listing.getEntries())
    {
        Fuzz::require(names.count(entry.name) == 1, "what is listed is there");
        Fuzz::require(listed.insert(entry.name).second, "what is there is listed once");
        files += entry.isDirectory ? 1 : static_cast<std::size_t>(entry.size);
    }
    Fuzz::require(files == names.size(), "all that is there is listed");
    for (QtDirListing::Key const key : {QtDirListing::Name, QtDirListing::Size, QtDirListing::Modified})
        for (bool const descending : {false, true})
        {
            std::vector<int> rows = listing.sort(key, descending);
            std::sort(rows.begin(), rows.end());
            Fuzz::require(rows.size() == listing.getEntries().size() &&
                              std::adjacent_find(rows.begin(), rows.end()) == rows.end(),
                          "an order has each row once");
        }
}

/// A browser in its window, as who sits before it has it.
class Sight
{
public:
    explicit Sight(fs::path const& folder)
        : window(Fuzz::makeWindow()), browser(BrBrowser::create(window->getRootContainer(), "browser", nullptr)),
          _folder(folder)
    {
        browser->setSequencesCollapsed(false);
        browser->setMultiple(true);
        goTo(folder);
        window->show();
        QWidget const* const shown = QApplication::activeModalWidget();
        Fuzz::require(shown, "the window is shown");
        _list = shown->findChild<QTreeView*>("browser.list");
        _field = shown->findChild<QLineEdit*>("browser.path");
        press(*_list, Qt::Key_H, Qt::ControlModifier);
    }

    bool goTo(fs::path const& path) const
    {
        return browser->setURL(path.string(), HistoryEnum::None, UpdateEnum::AtOnce);
    }

    /// The folder's rows are those of the names, and one name after the other is in focus as its row is selected.
    void requireRows(std::set<std::string> const& names) const
    {
        Fuzz::require(goTo(_folder), "the folder is there");
        turnUntil([&] { return _list->model()->rowCount() == static_cast<int>(names.size()); }, "a row for each name");
        std::set<std::string> chosen;
        for (int row = 0; row < _list->model()->rowCount(); ++row)
        {
            _list->setCurrentIndex(_list->model()->index(row, 0));
            fs::path const path = browser->getInputFocusPath().toString();
            Fuzz::require(path.parent_path() == _folder, "what a row stands for is in the folder");
            chosen.insert(path.filename().string());
        }
        Fuzz::require(chosen == names, "each name has its row");
    }

    /// Types a text, lets it be completed and presses Enter.
    void type(std::string const& text) const
    {
        _field->selectAll();
        press(*_field, Qt::Key_unknown, Qt::NoModifier, QString::fromStdString(text));
        turn();
        QWidget* const proposals = QApplication::activePopupWidget();
        press(proposals ? *proposals : *_field, Qt::Key_Return, Qt::NoModifier, "\r");
        turn();
        Fuzz::require(fs::is_directory(browser->getPath().toString()), "Enter leads to a directory, or nowhere");
    }

    RCShdPtr<UiTopLevel> window;
    RCShdPtr<BrBrowser> browser;

private:
    static void turn() { QApplication::processEvents(QEventLoop::AllEvents); }

    static void turnUntil(std::function<bool()> const& holds, char const* what)
    {
        constexpr std::chrono::seconds patience(10);
        auto const end = std::chrono::steady_clock::now() + patience;
        while (!holds())
        {
            Fuzz::require(std::chrono::steady_clock::now() < end, what);
            QApplication::processEvents(QEventLoop::WaitForMoreEvents);
        }
    }

    static void press(QWidget& widget, int key, Qt::KeyboardModifiers modifiers = {}, QString const& text = {})
    {
        QKeyEvent event(QEvent::KeyPress, key, modifiers, text);
        QApplication::sendEvent(&widget, &event);
    }

    fs::path _folder;
    QTreeView* _list = nullptr;
    QLineEdit* _field = nullptr;
};

/// Asks for a path as the browser's field does. It leads somewhere, or is refused in words.
void requirePlace(std::string const& path, std::string const& base)
{
    for (auto const find : {&OsPlace::find, &OsPlace::findNew})
        try
        {
            OsPlace const place = find(OsPlace::complete(path, base));
            Fuzz::require(fs::is_directory(place.directory), "a place is in a directory");
            Fuzz::require(place.name.find('/') == std::string::npos, "a name is one component");
        }
        catch (ExBase const& error)
        {
            Fuzz::require(error.getReason()[0] != '\0', "an error has words");
        }
    Fuzz::require(fs::is_directory(OsPlace::findNearest("/" + path)), "the nearest directory exists");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    static Fuzz::Folder const root;
    fs::path const folder = root.getPath() / "shown";
    std::vector<std::string> const lines = split(Fuzz::asText(data, size));
    std::set<std::string> const names = makeEntries(folder, lines);
    requireListing(folder, names, false);
    requireListing(folder, names, true);

    Sight const sight(folder);
    sight.requireRows(names);
    for (std::string const& name : names)
    {
        Fuzz::require(sight.goTo(folder / name), "the browser goes to what is there");
        BrBrowser const& browser = *sight.browser;
        std::string const there =
            fs::is_directory(folder / name) ? browser.getPath().toString() : browser.getInputFocusPath().toString();
        Fuzz::require(there == (folder / name).string(), "the browser shows what was asked for");
    }
    for (std::string const& line : lines)
    {
        requirePlace(line, folder.string());
        std::string const before = sight.browser->getPath().toString();
        if (!sight.goTo(line))
            Fuzz::require(sight.browser->getPath().toString() == before, "a refused path changes nothing");
        sight.type(line);
    }
    sight.requireRows(names);
    return 0;
}
