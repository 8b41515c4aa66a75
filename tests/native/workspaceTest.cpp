#include <boost/python.hpp>

#include "brBrowsable.h"
#include "pyGraph.h"
#include "uiCompositionWorkspace.h"
#include "uiLabel.h"
#include "uiWorkspace.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <string>

namespace bp = boost::python;
namespace fs = std::filesystem;

using namespace Kv;

namespace
{

/// A script in an application with two files of compositions, "a" and "b", of which none is open.
class Application : public testing::Test
{
protected:
    Application()
    {
        std::string name = (fs::temp_directory_path() / "workspace-XXXXXX").string();
        folder = fs::canonical(mkdtemp(name.data()));
        for (char const* const file : {"a", "b"})
            std::ofstream(pathOf(file).toString())
                << "<composition><node name='Grade' type='ColourGrade'><value name='gain' text='1'/>"
                   "<input name='source' node='Read'/></node><node name='Read' type='ImageReader'/></composition>";
        UiWorkspace::setCurrentWorkspace(workspace);
        names["__builtins__"] = bp::import("builtins");
        names["folder"] = folder.string();
        run("import os\n"
            "from quorvane_velmora import graph, ui\n"
            "ws, path_a = ui.Workspace, os.path.join(folder, 'a.vmcomposition')\n"
            "def refusal(call, *arguments):\n"
            "    try:\n"
            "        return call(*arguments)\n"
            "    except Exception as error:\n"
            "        return type(error).__name__ + ': ' + str(error)\n");
    }
    ~Application() override
    {
        UiWorkspace::setCurrentWorkspace(nullptr);
        fs::remove_all(folder);
    }

    OsFilePath pathOf(std::string const& name) const
    {
        return OsFilePath((folder / (name + ".vmcomposition")).string());
    }

    void run(char const* text) { bp::exec(text, names); }

    std::string evaluate(char const* text) { return bp::extract<std::string>(bp::str(bp::eval(text, names))); }

    fs::path folder;
    UiWidget* focus = nullptr;
    RCShdPtr<UiCompositionWorkspace> workspace = makeShd<UiCompositionWorkspace>([this] { return focus; });
    bp::dict names;
};

class Widget : public UiLabel
{
public:
    Widget() : UiLabel("Browser") {}
};

class View : public UiView
{
public:
    RCShdPtr<SnSelection> getSelection() override { return selection; }

    RCShdPtr<SnSelection> selection;
};

} // namespace

TEST_F(Application, ShowsItsCompositionsToScripts)
{
    EXPECT_EQ(evaluate("(ws.getNbCompositions(), ws.getCompositions(), refusal(ws.getCurrentComposition))"),
              "(0, [], 'UiError: There is no current composition.')");
    workspace->open(pathOf("a"));
    workspace->open(pathOf("b"));
    run("a, b = ws.getCompositions()\ncurrent, again = ws.getCurrentComposition(), ws.getCurrentComposition()\n");
    EXPECT_EQ(evaluate("(ws.getNbCompositions(), a.getName(), b.getName(), type(a) is graph.Graph)"),
              "(2, 'a', 'b', True)");
    EXPECT_EQ(evaluate("(current is again, current == again == b, current != b, a == b, a != b, a == 'a', a != None, "
                       "len({a, b, current, again}))"),
              "(False, True, False, False, True, False, True, 2)");
    run("ws.openComposition(a)\nos.chdir(folder)\n");
    EXPECT_EQ(evaluate("ws.getCurrentComposition() == a"), "True");
    EXPECT_EQ(evaluate("[ws.isCompositionOpened(path) for path in ('a.vmcomposition', path_a, 'c.vmcomposition')]"),
              "[True, True, False]");
}

TEST_F(Application, LetsScriptsReadAndChangeAComposition)
{
    workspace->open(pathOf("a"));
    run("a = ws.getCurrentComposition()\n");
    EXPECT_EQ(evaluate("(a.getPath() == path_a, a.isWritable(), a.getNodes(), a.getNodeType('Grade'))"),
              "(True, True, ['Grade', 'Read'], 'ColourGrade')");
    EXPECT_EQ(evaluate("(a.getNodeInputs('Grade'), a.getNodeValues('Grade'), a.getNodeValues('Read'))"),
              "({'source': 'Read'}, {'gain': '1'}, {})");
    EXPECT_EQ(evaluate("repr(a) == '<Graph \\'a\\' of %r>' % path_a"), "True");
    EXPECT_EQ(evaluate("[refusal(call, 'Blur') for call in (a.getNodeType, a.getNodeInputs, a.getNodeValues)]"
                       " == [\"GraphError: The composition 'a' has no node 'Blur'.\"] * 3"),
              "True");
    EXPECT_NE(evaluate("refusal(a.setNodeValue, 'Blur', 'gain', '2')").find("has no node 'Blur'"), std::string::npos);
    EXPECT_EQ(evaluate("refusal(a.setNodeValue, 'Grade', 'gain', '\\0').split(':')[0]"), "GraphError");
    EXPECT_EQ(evaluate("a.getNodeValues('Grade')"), "{'gain': '1'}");
    run("a.setNodeValue('Grade', 'gain', '2')\nbefore = open(path_a).read()\na.save()\n");
    EXPECT_EQ(evaluate("('text=\"2\"' in before, 'text=\"2\"' in open(path_a).read())"), "(False, True)");
}

TEST_F(Application, LetsScriptsChangeWhatCanBeWritten)
{
    workspace->open(pathOf("a"));
    fs::permissions(pathOf("a").toString(), fs::perms::owner_read);
    run("read_only = ws.getCurrentComposition()\n");
    fs::permissions(pathOf("a").toString(), fs::perms::owner_all);
    run("a = ws.getCurrentComposition()\n");
    EXPECT_EQ(evaluate("(read_only.isWritable(), a.isWritable(), read_only == a)"), "(False, True, True)");
    EXPECT_EQ(evaluate("[refusal(*call).split(': ')[:2] for call in "
                       "((read_only.setNodeValue, 'Read', 'file', 'x'), (read_only.save,))]"),
              "[['GraphError', \"The composition 'a' is read-only\"], "
              "['GraphError', \"The composition 'a' is read-only\"]]");
    EXPECT_EQ(evaluate("repr(read_only).endswith(', read-only>')"), "True");
    run("a.setNodeValue('Read', 'file', 'x')\n");
    EXPECT_EQ(evaluate("read_only.getNodeValues('Read')"), "{'file': 'x'}");
    fs::permissions(pathOf("a").toString(), fs::perms::owner_read);
    EXPECT_EQ(evaluate("(a.isWritable(), refusal(a.save).split(':')[0])"), "(False, 'GraphError')");
    EXPECT_EQ(evaluate("refusal(a.setNodeValue, 'Read', 'file', 'y').split(':')[0]"), "GraphError");
    fs::remove(pathOf("a").toString());
    run("a.save()\n");
    EXPECT_EQ(evaluate("(a.isWritable(), os.path.exists(path_a))"), "(True, True)");
}

TEST_F(Application, ClosesCompositionsThatScriptsStillHave)
{
    RCWeakPtr<const PiCompositionGraphInterface> const composition = workspace->open(pathOf("a"));
    run("a, again = ws.getCurrentComposition(), ws.getCurrentComposition()\n");
    workspace->close(composition);
    EXPECT_TRUE(composition.isExpired());
    EXPECT_EQ(evaluate("{refusal(*call) for call in ((a.getName,), (a.getPath,), (a.isWritable,), (a.getNodes,), "
                       "(a.getNodeType, 'Read'), (a.getNodeInputs, 'Read'), (a.getNodeValues, 'Read'), "
                       "(a.setNodeValue, 'Read', 'file', 'x'), (a.save,))}"),
              "{\"GraphError: The composition 'a' has been closed.\"}");
    EXPECT_EQ(evaluate("(a == again, hash(a) == hash(again), repr(a))"), "(True, True, \"<Graph 'a', closed>\")");
    EXPECT_EQ(evaluate("refusal(ws.openComposition, a)"),
              "RuntimeError: The composition is not open: it has been closed");
    workspace->open(pathOf("a"));
    EXPECT_EQ(evaluate("ws.getCurrentComposition() == a"), "False") << "it is another one on the same file";
}

TEST_F(Application, OpensWhatAScriptHasRead)
{
    run("a, other = graph.readComposition(path_a), graph.readComposition(path_a)\n"
        "a.setNodeValue('Grade', 'gain', '2')\n");
    EXPECT_EQ(evaluate("(a == other, other.getNodeValues('Grade'), ws.getNbCompositions(), a.isWritable())"),
              "(False, {'gain': '1'}, 0, True)");
    run("ws.openComposition(a)\n");
    EXPECT_EQ(evaluate("(ws.getCurrentComposition() == a, ws.getCurrentComposition().getNodeValues('Grade'))"),
              "(True, {'gain': '2'})");
    workspace->open(pathOf("b"));
    run("ws.openComposition(other)\n");
    EXPECT_EQ(evaluate("(ws.getNbCompositions(), ws.getCurrentComposition() == a, other.getNodeValues('Grade'))"),
              "(2, True, {'gain': '1'})")
        << "its file is open already";
    run("other.setNodeValue('Grade', 'gain', '3')\nws.openComposition(ws.getCompositions()[1])\n");
    EXPECT_EQ(
        evaluate("refusal(ws.openComposition, other) == \"RuntimeError: Cannot open '%s': it is open already, and "
                 "what was read has changes that are not saved\" % path_a"),
        "True");
    EXPECT_EQ(evaluate("ws.getCurrentComposition().getName()"), "b");
    run("again = ws.getCompositions()[0]\ndel a\n");
    EXPECT_EQ(evaluate("again.getNodeValues('Grade')"), "{'gain': '2'}") << "no script has to keep it";
    run("a = again\nws.openComposition(a)\n");
    workspace->close(workspace->getCurrentComposition());
    EXPECT_EQ(evaluate("{refusal(a.getNodes), refusal(a.save), refusal(other.getNodes) == ['Grade', 'Read']}"
                       " == {\"GraphError: The composition 'a' has been closed.\", True}"),
              "True");
    run("ws.openComposition(other)\nunseen = graph.readComposition(path_a)\nws.openComposition(unseen)\n");
    EXPECT_EQ(evaluate("(ws.getCurrentComposition() == other, unseen.getNodeValues('Grade'))"),
              "(True, {'gain': '1'})");
}

TEST_F(Application, ShowsScriptsWhatIsSelectedInTheBrowserWithTheKeyboard)
{
    EXPECT_EQ(evaluate("ws.getBrowserSelection()"), "[]");
    RCShdPtr<Widget> const widget = makeShd<Widget>();
    focus = widget.get();
    EXPECT_EQ(evaluate("ws.getBrowserSelection()"), "[]") << "no browser";
    RCShdPtr<View> const view = makeShd<View>();
    widget->addClientData(makeShd<PyManagedObject<int>>(1));
    widget->addClientData(view);
    EXPECT_EQ(evaluate("ws.getBrowserSelection()"), "[]") << "no selection";
    auto const item = [](char const* path)
    { return makeShd<const BrBrowsableItem>(makeShd<BrBrowsable>(LiString(path))); };
    view->selection =
        makeShd<SnSelection>(SnSelection::Items{item("/shows/\xc3\xa9t\xff"), makeShd<const SnItem>(), item("/other")});
    EXPECT_EQ(evaluate("[os.fsencode(path) for path in ws.getBrowserSelection()]"),
              "[b'/shows/\\xc3\\xa9t\\xff', b'/other']");
}

TEST_F(Application, NeedsAWorkspaceThatKnowsCompositions)
{
    class Plain : public UiWorkspace
    {
    public:
        UPtr<UiWidget> getFocus() const override { return {}; }
    };
    UiWorkspace::setCurrentWorkspace(makeShd<Plain>());
    EXPECT_EQ(evaluate("refusal(ws.getNbCompositions)"), "RuntimeError: Assertion failed: ! compWorkspace.isNull()");
    EXPECT_EQ(evaluate("ws.getBrowserSelection()"), "[]");
}

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    Py_Initialize();
    bp::import("sys").attr("path").attr("insert")(0, KV_PACKAGE_DIR);
    int const result = RUN_ALL_TESTS();
    return Py_FinalizeEx() == 0 ? result : 1;
}
