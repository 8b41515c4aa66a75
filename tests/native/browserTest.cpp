#include "brBrowsable.h"
#include "brBrowser.h"
#include "browser/qtDirListing.h"
#include "browser/qtDirWorker.h"
#include "exBase.h"
#include "files/osPlace.h"
#include "piWidget.h"
#include "uiTopLevel.h"
#include "uiWorkspace.h"
#include "wsNative.h"

#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QScrollBar>
#include <QTest>
#include <QTreeView>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <gtest/gtest.h>
#include <memory>
#include <random>
#include <set>
#include <string>
#include <thread>
#include <unistd.h>
#include <vector>

using namespace Kv;

namespace fs = std::filesystem;

namespace
{

/// A folder of the test's own.
class Folder : public testing::Test
{
protected:
    Folder()
    {
        std::string pattern = fs::temp_directory_path() / "browserXXXXXX";
        folder = mkdtemp(pattern.data());
        fs::permissions(folder, fs::perms(0755));
    }

    ~Folder() override { fs::remove_all(folder); }

    void make(std::vector<std::string> const& names) const
    {
        for (std::string const& name : names)
            if (name.back() == '/')
                fs::create_directories(folder / name);
            else
                std::ofstream(folder / name) << name;
    }

    /// The titles as they stand from top to bottom.
    std::vector<std::string> list(bool collapsed, QtDirListing::Key key = QtDirListing::Name,
                                  bool descending = false) const
    {
        QtDirListing::Options options;
        options.collapses = [collapsed](std::string const&) { return collapsed; };
        QtDirListing const listing(folder, options, false);
        std::vector<std::string> titles;
        for (int const index : listing.sort(key, descending))
            titles.push_back(listing.getEntries().at(static_cast<std::size_t>(index)).title);
        return titles;
    }

    static void wait(std::function<bool()> const& condition) { EXPECT_TRUE(QTest::qWaitFor(condition, 5000)); }

    fs::path folder;
};

/// A browser, alone in a window once that is shown.
class Browser : public Folder
{
public:
    void onActivated(EvEvent&) { activated.push_back(focus()); }

protected:
    Browser()
        : window(UiTopLevel::create("window", "Window",
                                    WsWindowStyleUtils::getNormalWindowStyle({0, 500, 0, 300}, 0, BorderStyle(0),
                                                                             TitleBarStyle(0), TaskBarStyle(0),
                                                                             StackingStyle(0), CloseButtonStyle(1)),
                                    nullptr)),
          browser(BrBrowser::create(window->getRootContainer(), "b", nullptr)), activateCb(this, &Browser::onActivated)
    {
        UiConstraint::Edge const low{0, UiConstraint::Pixels, UiConstraint::ParentLow, {}};
        UiConstraint::Edge const high{0, UiConstraint::Pixels, UiConstraint::ParentHigh, {}};
        browser->setConstraint(UiConstraint({low, low, high, high}));
        browser->getPiWidget()->addCallback(PiWidget::Activate, &activateCb);
    }

    bool goTo(std::string const& path) const { return browser->setURL(path, HistoryEnum::None, UpdateEnum::AtOnce); }

    void showAt(fs::path const& path)
    {
        goTo(path);
        window->show();
        browser->getParent()->focusFirst();
        wait([this] { return rows() > 0; });
    }

    template <typename Widget> static Widget* find(char const* name)
    {
        return QApplication::activeModalWidget()->findChild<Widget*>(QLatin1String(name));
    }

    static QTreeView* view() { return find<QTreeView>("b.list"); }
    static int rows() { return view()->model()->rowCount(); }

    static std::string words()
    {
        QLabel const* const label = find<QLabel>("b.message");
        return label->isVisible() ? label->text().remove(QChar(0x200b)).toStdString() : "";
    }

    static void press(std::vector<Qt::Key> const& keys)
    {
        for (Qt::Key const key : keys)
            QTest::keyClick(QApplication::focusWidget(), key);
    }

    static void type(char const* path, bool enter)
    {
        QTest::keyClick(view(), Qt::Key_L, Qt::ControlModifier);
        QTest::keyClicks(find<QLineEdit>("b.path"), QLatin1String(path));
        if (enter)
            press({Qt::Key_Return});
    }

    /// True if what is typed leads somewhere.
    bool takeTypedPath() const
    {
        bool taken = false;
        browser->takeTypedPath([&] { taken = true; });
        return taken;
    }

    std::string focus() const { return browser->getInputFocusPath().toString(); }
    std::string place() const { return browser->getPath().toString(); }

    std::vector<std::string> selection() const
    {
        using Convert = SnItemConvert<RCShdPtr<BrBrowsable>>;
        EXPECT_EQ(browser->getClientDataListSize(), 1);
        RCShdPtr<UiView> const seen = dynamicCast<UiView>(browser->getClientDataListPtr()[0]);
        RCShdPtr<const SnSelection> const browsables = seen->getSelection()->filter(Convert::getPredicate());
        std::vector<std::string> paths;
        for (RCShdPtr<const SnItem> const& item : *browsables)
            paths.push_back(Convert::get(item)->getPath().toString());
        return paths;
    }

    RCShdPtr<UiTopLevel> window;
    RCShdPtr<BrBrowser> browser;
    UiEventCallback<Browser> activateCb;
    std::vector<std::string> activated;
};

} // namespace

TEST_F(Folder, IsReadAndSortedWhateverItsSizeAndNoLongerThanItIsWanted)
{
    constexpr std::size_t count = 10000;
    for (std::size_t number = 0; number < count; ++number)
        make({"file" + std::to_string(number * 7919 % count)});
    QtDirListing const listing(folder, {}, false);
    ASSERT_EQ(listing.getEntries().size(), count);
    std::vector<int> const sorted = listing.sort(QtDirListing::Name, true);
    auto const keyOf = [&](int index) { return listing.getEntries()[static_cast<std::size_t>(index)].sortKey; };
    EXPECT_TRUE(std::is_sorted(sorted.begin(), sorted.end(), [&](int a, int b) { return keyOf(a) > keyOf(b); }));
    EXPECT_EQ(std::set<int>(sorted.begin(), sorted.end()).size(), count);
    EXPECT_EQ(QtDirListing(folder, {}, true).getEntries().size(), 0U);
}

TEST_F(Folder, IsListedAsPeopleCountWithFoldersFirst)
{
    make({"b10", "B2", "b02x", "a", "c/", "Z9/", "z10/", ".hidden", "\xff", "b1"});
    std::ofstream(folder / "a") << std::string(100, 'a');
    fs::create_symlink("/nowhere", folder / "link");
    using Names = std::vector<std::string>;
    EXPECT_EQ(list(false), (Names{"c", "Z9", "z10", "a", "b1", "B2", "b02x", "b10", "link", "\xff"}));
    Names const bySize = list(false, QtDirListing::Size, true);
    EXPECT_EQ(bySize.at(0), "z10");
    EXPECT_EQ(bySize.at(3), "a");
}

TEST_F(Folder, CollapsesNumberedFilesOfOneKind)
{
    make({"f.0001.exr", "f.0002.exr", "f.0003.exr", "f.0007.exr", "f.12.exr", "g_v002.0010.exr", "g_v002.0011.exr",
          "s01.png", "s03.png", "s05.png", "s07.png", "clip.mp42", "clip.mp43", "n.01", "n.02", "d01/", "d02/"});
    EXPECT_EQ(list(true),
              (std::vector<std::string>{"d01", "d02", "clip.mp42", "clip.mp43", "f.####.exr  1-3, 7", "f.12.exr",
                                        "g_v002.####.exr  10-11", "n.##  1-2", "s##.png  1-7, 3 missing"}));
    EXPECT_EQ(list(false).size(), 17);
}

TEST_F(Folder, IsFoundByPathsAsPeopleWriteThem)
{
    make({"sub/", "file"});
    std::string const root = folder;
    setenv("HOME", root.c_str(), 1); // NOLINT(concurrency-mt-unsafe)
    auto const find = [&](std::string const& path)
    {
        OsPlace const place = OsPlace::find(OsPlace::complete(path, root + "/sub"));
        return place.directory + "|" + place.name;
    };
    EXPECT_EQ(find("../file"), root + "|file");
    EXPECT_EQ(find("~/sub//"), root + "/sub|");
    EXPECT_EQ(find("~"), root + "|");
    EXPECT_EQ(find("."), root + "/sub|");
    EXPECT_EQ(find("/.."), "/|");
    for (char const* const path : {"none", "../file/", "~none", "../file/x", "none/..", "../file/..", "../file/."})
        EXPECT_THROW(find(path), ExBase) << path;
    make({"far/deep/"});
    fs::create_directory_symlink(folder / "far/deep", folder / "sub/link");
    EXPECT_EQ(find("link"), root + "/sub/link|");
    EXPECT_EQ(find("link/.."), root + "/far|");
    EXPECT_EQ(find("link/./../../file"), root + "|file");
    OsPlace const added = OsPlace::findNew(root + "/sub/link/../new");
    EXPECT_EQ(added.directory + "|" + added.name, root + "/far|new");
    for (char const* const path : {"../file", ".", "none/new", "new/", "../file/new"})
        EXPECT_THROW(OsPlace::findNew(OsPlace::complete(path, root + "/sub")), ExBase) << path;
    EXPECT_EQ(OsPlace::findNearest(root + "/sub/a/b"), root + "/sub");
}

TEST_F(Folder, IsReadInAThreadThatIsCancelledAndLeftAtAnyMoment)
{
    WsNative::getPlatform();
    for (int number = 0; number < 300; ++number)
        make({"file" + std::to_string(number)});
    std::minstd_rand random(1); // NOLINT(cert-msc32-c,cert-msc51-cpp): the same each time
    auto worker = std::make_unique<QtDirWorker>();
    int started = 0;
    int seen = 0;
    auto const makeReading = [&]() -> QtDirWorker::Work
    {
        auto const see = [&, number = ++started](std::size_t count)
        {
            EXPECT_EQ(number, started);
            EXPECT_EQ(count, 300U);
            ++seen;
        };
        return [see, directory = folder.native()](std::atomic<bool> const& cancelled) -> std::function<void()>
        {
            try
            {
                QtDirListing const listing(directory, QtDirListing::Options(), cancelled);
                return [see, count = listing.getEntries().size()] { see(count); };
            }
            catch (ExBase const&)
            {
                // The test is over, and the directory is gone.
                return [] {};
            }
        };
    };
    for (int step = 0; step < 3000; ++step)
    {
        std::this_thread::sleep_for(std::chrono::microseconds(random() % 300));
        std::string const path = folder / std::to_string(random() % 3);
        auto const chance = random() % 8;
        if (chance == 0)
            worker = std::make_unique<QtDirWorker>();
        else if (chance == 1)
            worker->cancel();
        else if (chance == 2)
            worker->startAndWait(path, makeReading());
        else if (chance < 5)
            worker->start(path, makeReading());
        else
            QCoreApplication::processEvents();
    }
    wait([&] { return !worker->isBusy(); });
    EXPECT_GT(seen, 100);
    EXPECT_LE(seen, started);
}

TEST_F(Browser, GoesAndSelectsWithoutAWindow)
{
    make({"sub/", "a", "b", "c.vmcomposition"});
    EXPECT_EQ(place(), "/");
    EXPECT_TRUE(goTo(folder / "sub/.."));
    EXPECT_EQ(place(), folder);
    EXPECT_EQ(focus(), "");
    EXPECT_TRUE(goTo(folder / "a"));
    EXPECT_FALSE(goTo(folder / "none"));
    EXPECT_EQ(focus(), folder / "a");
    EXPECT_EQ(selection(), std::vector<std::string>{folder / "a"});
    fs::remove(folder / "a");
    EXPECT_TRUE(selection().empty());
    SnSelection::Items items{makeShd<SnItem>()};
    for (char const* const name : {"b", "sub", "sub/x"})
        items.push_back(makeShd<BrBrowsableItem>(makeShd<BrBrowsable>(LiString(folder / name))));
    browser->setMultiple(true);
    browser->select(makeShd<SnSelection>(items));
    EXPECT_EQ(selection(), (std::vector<std::string>{folder / "b", folder / "sub"}));
    RCShdPtr<UiView> const left = dynamicCast<UiView>(browser->getClientDataListPtr()[0]);
    browser->clearParent();
    browser.reset();
    EXPECT_TRUE(left->getSelection().isNull());
}

TEST_F(Browser, IsWalkedByTheKeyboard)
{
    make({"sub/", "sub/deep.txt", "b\xff.txt", "notes.txt"});
    showAt(folder);
    EXPECT_EQ(QApplication::focusWidget(), view());
    press({Qt::Key_Down, Qt::Key_Return});
    EXPECT_EQ(place(), folder / "sub");
    wait([] { return rows() == 1; });
    press({Qt::Key_End, Qt::Key_Return});
    EXPECT_EQ(activated, std::vector<std::string>{folder / "sub/deep.txt"});
    press({Qt::Key_Backspace});
    EXPECT_EQ(place(), folder);
    EXPECT_EQ(focus(), "");
    wait([] { return rows() == 3; });
    EXPECT_EQ(view()->currentIndex().data().toString(), QLatin1String("sub"));
    QTest::keyClicks(view(), QLatin1String("b"));
    EXPECT_EQ(selection(), std::vector<std::string>{folder / "b\xff.txt"});
    QTest::keyClick(view(), Qt::Key_Up, Qt::AltModifier);
    EXPECT_EQ(place(), folder.parent_path());
}

TEST_F(Browser, GoesWhereThePathIsTyped)
{
    make({"sub/", "sub/f", ".secret", "z"});
    showAt(folder);
    type("none", true);
    EXPECT_EQ(place(), folder);
    EXPECT_NE(words().find((folder / "none").string()), std::string::npos);
    browser->setTakesNew(false);
    EXPECT_FALSE(takeTypedPath());
    browser->setTakesNew(true);
    EXPECT_TRUE(takeTypedPath());
    EXPECT_EQ(focus(), folder / "none");
    EXPECT_EQ(place(), folder);
    type("none/none", false);
    EXPECT_FALSE(takeTypedPath());
    EXPECT_EQ(focus(), "");
    press({Qt::Key_Escape});
    type("sub/f", true);
    EXPECT_EQ(focus(), folder / "sub/f");
    EXPECT_EQ(words(), "");
    wait([] { return view()->currentIndex().isValid(); });
    EXPECT_EQ(QApplication::focusWidget(), view());
    type("../.secret", false);
    EXPECT_TRUE(takeTypedPath());
    EXPECT_EQ(focus(), folder / ".secret");
    wait([] { return rows() == 3; });
    EXPECT_EQ(view()->currentIndex().data().toString(), QLatin1String(".secret"));
    EXPECT_TRUE(activated.empty());
}

TEST_F(Browser, FollowsWhatBecomesOfItsDirectory)
{
    make({"deep/er/"});
    for (int number = 100; number < 200; ++number)
        make({"deep/er/f" + std::string(1, static_cast<char>('a' + number % 26)) + std::to_string(number) + ".mp4"});
    browser->setSequencesCollapsed(false);
    showAt(folder / "deep/er/fk192.mp4");
    wait([] { return view()->currentIndex().isValid(); });
    int const scroll = view()->verticalScrollBar()->value();
    int const height = view()->visualRect(view()->currentIndex()).height();
    make({"deep/er/a"});
    wait([] { return rows() == 101; });
    EXPECT_EQ(focus(), folder / "deep/er/fk192.mp4");
    EXPECT_EQ(view()->verticalScrollBar()->value(), scroll + height);
    fs::remove(folder / "deep/er/fk192.mp4");
    wait([this] { return focus().empty(); });
    fs::remove_all(folder / "deep");
    make({"deep"});
    wait([this] { return place() == folder; });
    EXPECT_NE(words().find((folder / "deep/er").string()), std::string::npos);
}

TEST_F(Browser, SaysWhyADirectoryCannotBeRead)
{
    make({"locked/", "locked/f"});
    fs::permissions(folder / "locked", fs::perms::none);
    uid_t const user = geteuid();
    constexpr uid_t nobody = 65534;
    ASSERT_EQ(seteuid(user == 0 ? nobody : user), 0);
    showAt(folder);
    press({Qt::Key_Down, Qt::Key_Return});
    wait([] { return !words().empty(); });
    ASSERT_EQ(seteuid(user), 0);
    EXPECT_EQ(place(), folder / "locked");
    EXPECT_EQ(rows(), 0);
    EXPECT_NE(words().find("Permission denied"), std::string::npos);
    fs::permissions(folder / "locked", fs::perms::owner_all);
    wait([] { return rows() == 1 && words().empty(); });
}

TEST_F(Browser, ShowsSequencesAndCompositionsAsItIsTold)
{
    make({"f.01.exr", "f.02.exr", "c.01.vmcomposition", "c.02.vmcomposition"});
    showAt(folder);
    EXPECT_EQ(rows(), 3);
    goTo(folder / "f.02.exr");
    wait([] { return view()->currentIndex().isValid(); });
    EXPECT_EQ(focus(), folder / "f.02.exr");
    press({Qt::Key_Home, Qt::Key_End});
    EXPECT_EQ(focus(), folder / "f.01.exr");
    make({"f.03.exr"});
    fs::remove(folder / "f.01.exr");
    wait([this] { return focus() == folder / "f.02.exr"; });
    browser->setCompositionsCollapsed(true);
    wait([] { return rows() == 2; });
    browser->setSequencesCollapsed(false);
    wait([] { return rows() == 3; });
    EXPECT_EQ(selection(), std::vector<std::string>{folder / "f.02.exr"});
    UiEventCallback<Browser> loadCb(this, &Browser::onActivated);
    browser->getPiWidget()->removeCallback(PiWidget::Activate, &activateCb);
    browser->setLoadCb(&loadCb);
    press({Qt::Key_Return, Qt::Key_Home, Qt::Key_Return});
    EXPECT_EQ(activated, std::vector<std::string>{folder / "c.01.vmcomposition"});
    browser->setDontLoadCompositions(true);
    press({Qt::Key_Return});
    EXPECT_EQ(activated.size(), 1);
}
