#include "fwComposition.h"
#include "piGraph.h"
#include "pointers/rcWeakPtr.h"
#include "refusals.h"
#include "uiCompositionWorkspace.h"

#include <csignal>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <string>
#include <sys/resource.h>
#include <sys/stat.h>
#include <tuple>
#include <utility>
#include <vector>

using namespace Kv;
using namespace std::string_literals;

namespace fs = std::filesystem;

namespace
{

using Composition = RCWeakPtr<const PiCompositionGraphInterface>;

/// A folder of its own for each test, which is the current one too.
class Compositions : public testing::Test
{
protected:
    Compositions()
    {
        std::string name = (fs::temp_directory_path() / "compositions-XXXXXX").string();
        folder = fs::canonical(mkdtemp(name.data()));
        fs::current_path(folder);
    }
    ~Compositions() override
    {
        fs::current_path("/");
        fs::permissions(folder, fs::perms::owner_all);
        fs::remove_all(folder);
    }

    void write(std::string const& name, std::string const& text) const { std::ofstream(folder / name) << text; }

    std::string read(std::string const& name) const
    {
        std::ifstream file(folder / name);
        return {std::istreambuf_iterator<char>(file), {}};
    }

    OsFilePath pathOf(std::string const& name) const { return OsFilePath((folder / name).string()); }

    RCStrongPtr<FwComposition> open(std::string const& name) const { return FwComposition::open(pathOf(name)); }

    std::vector<std::string> listFiles() const
    {
        std::vector<std::string> names;
        for (auto const& entry : fs::directory_iterator(folder))
            names.push_back(entry.path().filename().string());
        return names;
    }

    fs::path folder;
};

constexpr char const* grade = R"(<composition>
  <node name="Grade" type="ColourGrade">
    <value name="gain" text="1.5"/>
    <input name="source" node="Read"/>
  </node>
  <node name="Read" type="ImageReader"/>
</composition>
)";

} // namespace

TEST_F(Compositions, NameTheFileAndTheLineOfWhatIsWrongWithThem)
{
    for (auto const& [line, part, text] : std::vector<std::tuple<int, char const*, char const*>>{
             {1, "no element", ""},
             {2, "", "<composition>\n</comp>"},
             {1, "'graph'", "<graph/>"},
             {2, "'noode'", "<composition>\n<noode/></composition>"},
             {2, "'colour'", "<composition>\n<node name='a' type='t' colour='c'/></composition>"},
             {1, "is no version: '1.5'", "<composition version='1.5'/>"},
             {1, "is no version: ''", "<composition version=''/>"},
             {1, "is no version: '-1'", "<composition version='-1'/>"},
             {1, "a later version of the application has written it, in version '2'",
              "<composition version='2' new=''/>"},
             {1, "a later version of the application",
              "<composition version='99999999999999999999'><new/></composition>"},
             {2, "no attribute 'name'", "<composition>\n<node type='t'/></composition>"},
             {2, "'name' of element 'node' is empty", "<composition>\n<node name='' type='t'/></composition>"},
             {2, "no attribute 'type'", "<composition>\n<node name='a'/></composition>"},
             {1, "holds a text", "<composition>text</composition>"},
             {3, "two nodes named 'a'",
              "<composition><node name='a' type='t'/>\n\n<node name='a' type='u'/></composition>"},
             {2, "'value'", "<composition><node name='a' type='t'>\n<value name='v'/></node></composition>"},
             {3, "two elements 'value' named 'v'",
              "<composition><node name='a' type='t'>\n<value name='v' text=''/>\n<value name='v' "
              "text=''/></node></composition>"},
             {2, "'deeper'",
              "<composition><node name='a' type='t'><value name='v' text=''>\n<deeper/></value></node></composition>"},
             {2, "node 'b', which is not there",
              "<composition><node name='a' type='t'>\n<input name='i' node='b'/></node></composition>"}})
    {
        write("wrong.vmcomposition", text);
        std::string const words = wordsOf([this] { open("wrong.vmcomposition"); });
        expectContains(words, (folder / "wrong.vmcomposition").string());
        expectContains(words, "line " + std::to_string(line) + ":");
        expectContains(words, part);
    }
    expectContains(wordsOf([this] { open(""); }), folder.string() + "': it is a folder");
    expectContains(wordsOf([this] { open("missing"); }), "missing': No such file");
    mkfifo((folder / "pipe").c_str(), 0600);
    expectContains(wordsOf([this] { open("pipe"); }), "no regular file");
}

TEST_F(Compositions, AreReadAgainExactlyAsTheyWereWritten)
{
    std::string const name = "sh\xff\xe9t.vmcomposition";
    std::string const text = " <&>\"'\t\r\n]]> \xe2\x82\xac\xf0\x9f\x8e\xac ";
    write(name, grade);
    RCStrongPtr<FwComposition> const composition = open(name);
    EXPECT_EQ(composition->getGraph()->getName(), "sh\xff\xe9t");
    composition->getGraph()->setNodeValue("Read", text, text);
    composition->getGraph()->setNodeValue("Grade", "lift", "");
    composition->getGraph()->setNodeValue("Grade", "gain", text);
    composition->save();
    RCStrongPtr<FwComposition> const again = open(name);
    std::vector<RCShdPtr<const PiNode>> const nodes = again->getGraph()->getNodes();
    ASSERT_EQ(nodes.size(), 2U);
    EXPECT_EQ(nodes[0]->getName() + " " + nodes[0]->getType(), "Grade ColourGrade");
    EXPECT_EQ(nodes[0]->getValues(), (PiNode::NamedTexts{{"gain", text}, {"lift", ""}}));
    EXPECT_EQ(nodes[0]->getInputs(), (PiNode::NamedTexts{{"source", "Read"}}));
    EXPECT_EQ(nodes[1]->getValues(), (PiNode::NamedTexts{{text, text}}));
    std::string const written = read(name);
    expectContains(written, "<composition version=\"1\">");
    again->save();
    EXPECT_EQ(read(name), written);
}

TEST_F(Compositions, StayAsTheyAreWhereAChangeIsRefused)
{
    write("shot.vmcomposition", grade);
    RCStrongPtr<FwComposition> composition = open("shot.vmcomposition");
    RCShdPtr<PiGraph> const graph = composition->getGraph();
    expectContains(wordsOf([&] { graph->setNodeValue("Blur", "size", "1"); }), "'shot' has no node 'Blur'");
    expectContains(wordsOf([&] { graph->setNodeValue("Read", "", "1"); }), "name");
    EXPECT_THROW(graph->setNodeValue("Read", "file", "zero\0"s), ExBase);
    EXPECT_THROW(graph->setNodeValue("Read", "file", "\xff"), ExBase);
    EXPECT_THROW(graph->setNodeValue("Read", "\x1b", "1"), ExBase);
    graph->setNodeValue("Grade", "gain", "1.5");
    EXPECT_FALSE(composition->isModified()) << "it had that value";
    RCShdPtr<const PiNode> const read = graph->findNode("Read");
    EXPECT_TRUE(read->getValues().empty());
    EXPECT_EQ(read->getGraph(), RCShdPtr<const PiGraph>(graph));
    composition = nullptr;
    expectContains(wordsOf([&] { graph->setNodeValue("Read", "file", "a"); }), "closed");
    EXPECT_TRUE(graph->getController().isExpired());
    EXPECT_TRUE(read->getGraph().isNull());
    EXPECT_EQ(graph->getNodes().size(), 2U);
}

TEST_F(Compositions, CanBeEditedWhereTheDiskCanBeWrittenNow)
{
    write("shot.vmcomposition", grade);
    RCStrongPtr<FwComposition> const composition = open("shot.vmcomposition");
    auto const set = [&composition](char const* text) { composition->getGraph()->setNodeValue("Read", "file", text); };
    set("a");
    fs::permissions("shot.vmcomposition", fs::perms::owner_read);
    EXPECT_FALSE(composition->isEditable());
    expectContains(wordsOf([&] { set("b"); }), "cannot be written");
    expectContains(wordsOf([&] { composition->save(); }), "permissions");
    EXPECT_TRUE(composition->isModified());
    fs::permissions("shot.vmcomposition", fs::perms(0640));
    EXPECT_TRUE(composition->isEditable());
    fs::permissions(folder, fs::perms(0500));
    EXPECT_FALSE(composition->isEditable());
    EXPECT_THROW(composition->save(), ExBase);
    fs::permissions(folder, fs::perms(0700));
    composition->save();
    EXPECT_FALSE(composition->isModified());
    EXPECT_EQ(fs::status("shot.vmcomposition").permissions(), fs::perms(0640));

    fs::remove("shot.vmcomposition");
    EXPECT_TRUE(composition->isEditable());
    composition->save();
    expectContains(read("shot.vmcomposition"), "text=\"a\"");
    fs::remove("shot.vmcomposition");
    fs::create_directory("shot.vmcomposition");
    EXPECT_FALSE(composition->isEditable());
    expectContains(wordsOf([&] { composition->save(); }), "it is a folder");
}

TEST_F(Compositions, AreNotSavedOverWhatOthersHaveWrittenUnlessToldTo)
{
    write("shot.vmcomposition", grade);
    RCStrongPtr<FwComposition> const composition = open("shot.vmcomposition");
    composition->getGraph()->setNodeValue("Read", "file", "mine");
    EXPECT_FALSE(composition->isChangedOnDisk());
    write("shot.vmcomposition", "of another, and longer than before" + std::string(grade));
    EXPECT_TRUE(composition->isChangedOnDisk());
    expectContains(wordsOf([&] { composition->save(); }), "changed on disk");
    expectContains(read("shot.vmcomposition"), "of another");
    EXPECT_TRUE(composition->isModified());
    composition->saveOver();
    expectContains(read("shot.vmcomposition"), "mine");
    EXPECT_FALSE(composition->isChangedOnDisk() || composition->isModified());
}

TEST_F(Compositions, AreSavedWhereTheirLinksLead)
{
    fs::create_directory("versions");
    write("versions/v3", grade);
    fs::create_symlink("v3", "versions/latest");
    fs::create_symlink("versions/latest", "shot.vmcomposition");
    RCStrongPtr<FwComposition> const composition = FwComposition::open(OsFilePath("./versions/../shot.vmcomposition"));
    EXPECT_EQ(composition->getPath(), pathOf("versions/v3"));
    composition->getGraph()->setNodeValue("Read", "file", "through links");
    composition->save();
    EXPECT_TRUE(fs::is_symlink("shot.vmcomposition") && fs::is_symlink("versions/latest"));
    expectContains(read("versions/v3"), "through links");
}

TEST_F(Compositions, AreAsTheyWereOnADiskThatIsFull)
{
    write("shot.vmcomposition", grade);
    RCStrongPtr<FwComposition> const composition = open("shot.vmcomposition");
    composition->getGraph()->setNodeValue("Read", "file", std::string(10000, 'x'));
    struct rlimit old = {};
    getrlimit(RLIMIT_FSIZE, &old);
    struct rlimit const little = {4096, old.rlim_max};
    auto const oldHandler = std::signal(SIGXFSZ, SIG_IGN);
    setrlimit(RLIMIT_FSIZE, &little);
    std::string const words = wordsOf([&] { composition->save(); });
    setrlimit(RLIMIT_FSIZE, &old);
    static_cast<void>(std::signal(SIGXFSZ, oldHandler));
    expectContains(words, "shot.vmcomposition': File too large");
    EXPECT_EQ(read("shot.vmcomposition"), grade);
    EXPECT_EQ(listFiles(), std::vector<std::string>{"shot.vmcomposition"});
    EXPECT_TRUE(composition->isModified());
}

namespace
{

std::string nameOf(Composition const& composition)
{
    return composition.isExpired() ? "none" : RCWeakAccessor(composition)->getGraph()->getName();
}

/// Writes down what is open, how many that is and which one is current, each time that the workspace tells of a change.
class Hearer
{
public:
    explicit Hearer(UiCompositionWorkspace& workspace)
    {
        workspace.setChangeCallback(
            [this, &workspace]
            {
                for (auto all = workspace.getCompositions(); !all.atEnd(); ++all)
                    _heard += nameOf(*all) + " ";
                _heard += "(" + std::to_string(workspace.getNbCompositions()) + "), current " +
                          nameOf(workspace.getCurrentComposition()) + "; ";
            });
    }

    std::string take() { return std::exchange(_heard, ""); }

private:
    std::string _heard;
};

} // namespace

TEST_F(Compositions, AreOpenedMadeCurrentAndClosedInAWorkspace)
{
    RCShdPtr<UiCompositionWorkspace> const workspace = makeShd<UiCompositionWorkspace>();
    Hearer hearer(*workspace);
    for (char const* const name : {"a", "b", "c"})
        write(name, grade);
    EXPECT_TRUE(workspace->getCurrentComposition().isExpired());
    EXPECT_TRUE(workspace->getFocus().isNull());
    Composition const a = workspace->open(pathOf("a"));
    EXPECT_EQ(hearer.take(), "a (1), current a; ");
    Composition const b = workspace->open(pathOf("b"));
    Composition const c = workspace->open(pathOf("c"));
    hearer.take();
    EXPECT_TRUE(workspace->open(pathOf("b")) == b);
    EXPECT_EQ(hearer.take(), "a b c (3), current b; ");
    workspace->openComposition(b);
    EXPECT_EQ(hearer.take(), "") << "it is current already";
    EXPECT_THROW(workspace->open(pathOf("missing")), ExBase);
    EXPECT_EQ(hearer.take(), "");

    RCWeakAccessor<const PiCompositionGraphInterface> const held(b);
    RCShdPtr<const PiGraph> const graph = held->getGraph();
    EXPECT_TRUE(workspace->getComposition(graph) == b);
    workspace->close(b);
    EXPECT_EQ(hearer.take(), "a c (2), current c; ");
    EXPECT_TRUE(workspace->getComposition(graph).isExpired()) << "closed, although it is held here";
    expectContains(wordsOf([&] { workspace->openComposition(b); }), "has been closed");
    EXPECT_THROW(workspace->close(b), ExBase);
    workspace->openComposition(a);
    hearer.take();
    workspace->close(c);
    EXPECT_EQ(hearer.take(), "a (1), current a; ");
    EXPECT_TRUE(c.isExpired());
    workspace->close(a);
    EXPECT_EQ(hearer.take(), "(0), current none; ");
    EXPECT_THROW(workspace->openComposition({}), ExBase);
}

TEST_F(Compositions, BelongToWhoHasReadThemUntilAWorkspaceTakesThemOver)
{
    RCShdPtr<UiCompositionWorkspace> const workspace = makeShd<UiCompositionWorkspace>();
    Hearer hearer(*workspace);
    write("shot", grade);
    FwComposition::Keeper keeper = FwComposition::openApart(pathOf("shot"));
    RCShdPtr<PiGraph> const graph = (*keeper)->getGraph();
    Composition const apart = workspace->getComposition(graph);
    EXPECT_FALSE(apart.isExpired() || workspace->isCompositionOpened(pathOf("shot")));
    EXPECT_THROW(workspace->close(apart), ExBase) << "it is not the workspace's";
    keeper.reset();
    EXPECT_TRUE(apart.isExpired() && workspace->getComposition(graph).isExpired());
    EXPECT_TRUE(workspace->getComposition(nullptr).isExpired());

    keeper = FwComposition::openApart(pathOf("shot"));
    RCShdPtr<PiGraph> const kept = (*keeper)->getGraph();
    kept->setNodeValue("Grade", "gain", "2");
    Composition const taken = workspace->getComposition(kept);
    workspace->openComposition(taken);
    EXPECT_EQ(hearer.take(), "shot (1), current shot; ");
    kept->setNodeValue("Grade", "gain", "3");
    EXPECT_EQ(hearer.take(), "shot (1), current shot; ");
    keeper.reset();
    EXPECT_TRUE(workspace->getCurrentComposition() == taken) << "it is the workspace's own now";
    workspace->close(taken);
    EXPECT_TRUE(taken.isExpired());
    EXPECT_EQ(hearer.take(), "(0), current none; ");
}

TEST_F(Compositions, TellTheirWorkspaceOfEachChange)
{
    RCShdPtr<UiCompositionWorkspace> workspace = makeShd<UiCompositionWorkspace>();
    write("shot", grade);
    Composition const composition = workspace->open(pathOf("shot"));
    EXPECT_TRUE(workspace->isCompositionEditable(composition));
    Hearer hearer(*workspace);
    // As the application has it: the graph is reached from the node, which keeps no const of its own.
    RCWeakAccessor<const PiCompositionGraphInterface> const held(composition);
    auto const writable =
        RCWeakAccessor(const_cast<PiNode&>(*held->getNode()).getController()).castTo<PiCompositionGraphInterface>();
    RCShdPtr<PiGraph> const graph = RCWeakAccessor(writable)->getGraph();
    graph->setNodeValue("Read", "file", "a");
    graph->setNodeValue("Read", "file", "a");
    EXPECT_EQ(hearer.take(), "shot (1), current shot; ");
    EXPECT_TRUE(held->isModified());
    workspace->save(composition);
    EXPECT_EQ(hearer.take(), "shot (1), current shot; ");
    EXPECT_FALSE(held->isModified());
    workspace = nullptr;
    graph->setNodeValue("Read", "file", "b");
    EXPECT_TRUE(held->isModified());
}

TEST_F(Compositions, AreKnownAsOpenByEveryPathOfTheirFile)
{
    UiCompositionWorkspace workspace;
    fs::create_directory("deep");
    write("deep/shot", grade);
    fs::create_symlink("deep", "alias");
    fs::create_symlink("alias/../deep/shot", "link");
    fs::create_symlink("link", "linktolink");
    fs::create_symlink("loop", "loop");
    Composition const composition = workspace.open(OsFilePath("link"));
    for (bool const isDeleted : {false, true})
    {
        if (isDeleted)
            fs::remove_all("deep");
        for (char const* const path : {"deep/shot", "./deep/../deep//shot", "alias/shot", "link", "linktolink"})
            EXPECT_TRUE(workspace.isCompositionOpened(OsFilePath(path))) << path << isDeleted;
        for (char const* const path : {"", "deep", "shot", "loop", "deep/other"})
            EXPECT_FALSE(workspace.isCompositionOpened(OsFilePath(path))) << path << isDeleted;
        EXPECT_EQ(workspace.isCompositionEditable(composition), !isDeleted) << "its folder went with it";
    }
    EXPECT_TRUE(workspace.isCompositionOpened(pathOf("deep/shot")));
}
