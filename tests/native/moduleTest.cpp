#include <boost/python.hpp>

#include "files/osFilePath.h"
#include "packages/inBuildInfo.h"
#include "packages/inInit.h"
#include "pyManagedDialog.h"
#include "pyUiError.h"
#include "refusals.h"
#include "uiCursorGuard.h"
#include "wsCursorRegistry.h"

#include <gtest/gtest.h>
#include <memory>
#include <regex>
#include <string>
#include <vector>

namespace bp = boost::python;

using namespace Kv;
using PyextUi::Dialog;
using PyextUi::UiError;

namespace
{

class Tag;
using TestError = PyextInit::ModError<Tag>;

/// The names of one script, with the module in it as `ui`.
class Script : public testing::Test
{
protected:
    Script()
    {
        names["__builtins__"] = bp::import("builtins");
        run("import gc, weakref\n"
            "from quorvane_velmora import ui\n"
            "def make():\n"
            "    entries = [('TextField', 'Text', '', 'old'), ('ToggleButton', 'Toggle', '', False)]\n"
            "    return ui.createDialog('Title', ui.makeXmlFromWidgetList(entries, []), 400, 112)\n");
    }

    void run(char const* text) { bp::exec(text, names); }

    std::string evaluate(char const* text) { return bp::extract<std::string>(bp::str(bp::eval(text, names))); }

    RCShdPtr<ManagedDialog> getManaged(char const* expression)
    {
        return bp::extract<RCShdPtr<ManagedDialog>&>(bp::eval(expression, names))();
    }

    bp::dict names;
};

void raiseThroughTheBase()
{
    std::unique_ptr<ExBase> const held(UiError("source.cpp", 17, "There is no such thing.").clone());
    held->raise();
}

} // namespace

TEST_F(Script, SeesAModuleErrorThatWasHeldAndRaisedAsTheBase)
{
    EXPECT_THROW(raiseThroughTheBase(), UiError);
    EXPECT_THROW(raiseThroughTheBase(), PyextInit::Error);
    EXPECT_EQ(UiError("source.cpp", 17, "reason").getModName(), "ui");
    names["fail"] = bp::make_function(&raiseThroughTheBase);
    run("try:\n    fail()\nexcept ui.UiError as error:\n    caught = error\n");
    EXPECT_EQ(evaluate("caught"), "There is no such thing.");
    EXPECT_EQ(evaluate("type(caught) is ui.UiError and type(caught).__mro__[1] is Exception"), "True");
}

TEST_F(Script, GetsNoExceptionTypeWithoutNames)
{
    expectContains(wordsOf<ExAssertionFailed>([] { TestError::initialize("", "TestError"); }), "!_modName.empty()");
    expectContains(wordsOf<ExAssertionFailed>([] { TestError::initialize("test", ""); }), "!_className.empty()");
    TestError::initialize("test", "TestError");
    TestError::exceptionTranslator(TestError("source.cpp", 17, "reason"));
    bp::handle<> const type(bp::borrowed(PyErr_Occurred()));
    PyErr_Clear();
    EXPECT_EQ(std::string(bp::extract<std::string>(bp::str(bp::object(type)))), "<class 'test.TestError'>");
    EXPECT_EQ(PyextInit::Error::newException("test", "TestError"), type.get());
}

TEST_F(Script, PassesPathsBothWaysByteForByteAndNothingElse)
{
    names["echo"] = bp::make_function(+[](OsFilePath const& path) { return path; });
    names["size"] = bp::make_function(+[](OsFilePath const& path) { return path.toString().size(); });
    run("import pathlib\n"
        "def fails(value):\n"
        "    try:\n        return echo(value)\n"
        "    except Exception as error:\n        return type(error).__name__\n");
    EXPECT_EQ(evaluate("[echo(''), echo('/a/b c'), echo(b'/b'), echo(pathlib.Path('/p'))]"),
              "['', '/a/b c', '/b', '/p']");
    EXPECT_EQ(evaluate("echo('/caf\\u00e9') == '/caf\\u00e9', size('/caf\\u00e9')"), "(True, 6)");
    EXPECT_EQ(evaluate("echo(b'/\\xff') == '/\\udcff' == echo('/\\udcff'), size('/\\udcff')"), "(True, 2)");
    EXPECT_EQ(evaluate("[fails(v) for v in ('a\\0b', b'a\\0', '\\ud800')]"),
              "['ValueError', 'ValueError', 'UnicodeEncodeError']");
    EXPECT_EQ(evaluate("[fails(v) for v in (None, 5, 1.5, ['/a'])]"), "['ArgumentError', 'ArgumentError', "
                                                                      "'ArgumentError', 'ArgumentError']");
}

TEST_F(Script, GetsNoDialogFromPointersToNone)
{
    EXPECT_THROW(bp::object(RCShdPtr<ManagedDialog>()), ExNullPtr);
    EXPECT_THROW(get_pointer(RCShdPtr<ManagedDialog>()), ExNullPtr);
    bp::object const none(makeShd<ManagedDialog>(RCShdPtr<Dialog>()));
    EXPECT_TRUE(none.is_none());
}

TEST_F(Script, GetsEachObjectFreshlyStampedAndTheirDialogOnce)
{
    run("dialog, given = make(), []\n"
        "dialog.addCallback('Toggle', ui.EventType.STATE, lambda one, *_: given.append(one))\n"
        "dialog.setValue('Toggle', True)\ndialog.setValue('Toggle', False)\n");
    RCShdPtr<ManagedDialog> const own = getManaged("dialog");
    for (char const* const expression : {"given[0]", "given[1]"})
    {
        RCShdPtr<ManagedDialog> const other = getManaged(expression);
        EXPECT_NE(other.get(), own.get());
        EXPECT_EQ(other->getValue(), own->getValue());
        EXPECT_EQ(other->getInterpreterId(), PiPythonUtils::getCurrentPythonInterpreterId());
    }
    EXPECT_EQ(own->getInterpreterId(), PiPythonUtils::getCurrentPythonInterpreterId());
    EXPECT_FALSE(own->getInterpreterId().is_nil());
}

TEST_F(Script, LeavesADialogThatNativeCodeHolds)
{
    run("dialog, heard = make(), []\n"
        "def callback(given, *_):\n"
        "    heard.append(given.getValue('Toggle'))\n"
        "callback.dialog = dialog\n"
        "gone, object_gone = weakref.ref(callback), weakref.ref(dialog)\n"
        "dialog.addCallback('Toggle', ui.EventType.STATE, callback)\n"
        "del callback\n");
    RCShdPtr<Dialog> dialog = getManaged("dialog")->getValue();
    run("del dialog\ngc.collect()\n");
    dialog->setValue("Toggle", bp::object(true));
    EXPECT_EQ(evaluate("heard"), "[True]");
    EXPECT_EQ(evaluate("object_gone() is None"), "False") << "its callable still has it";
    dialog.reset();
    run("gc.collect()\n");
    EXPECT_EQ(evaluate("(gone(), object_gone())"), "(None, None)");
}

TEST_F(Script, HasItsOwnExceptionComeThroughANativeLaunchThatIsWellUnwound)
{
    run("import signal\n"
        "class Own(BaseException): pass\n"
        "def alarm(*_):\n    raise Own()\n"
        "signal.signal(signal.SIGALRM, alarm)\n"
        "dialog = make()\n");
    UiCursorGuard const busy(WsCursorRegistry::Busy);
    RCShdPtr<Dialog> const dialog = getManaged("dialog")->getValue();
    for (int round = 0; round < 2; ++round)
    {
        run("signal.setitimer(signal.ITIMER_REAL, 0.05)\n");
        EXPECT_THROW(dialog->launch(), bp::error_already_set);
        EXPECT_TRUE(PyErr_ExceptionMatches(bp::object(names["Own"]).ptr()));
        PyErr_Clear();
        EXPECT_EQ(WsCursorRegistry::getInstance().getCurrent(), WsCursorRegistry::Busy);
    }
    run("del dialog\ngc.collect()\n");
    EXPECT_EQ(dialog->getReferenceCount(), 1);
}

TEST_F(Script, SharesTheWidgetsThatNativeCodeFindsByName)
{
    run("dialog = make()\n");
    Dialog const& dialog = *getManaged("dialog")->getValue();
    dialog.getWidget("Toggle")->setEnabled(false);
    EXPECT_EQ(evaluate("dialog.isEnabled('Toggle'), dialog.isEnabled('Text')"), "(False, True)");
    EXPECT_THROW(static_cast<void>(dialog.getWidget("Nobody")), UiError);
}

TEST(BuildInfo, OfTheModuleAndItsLibrariesIsThatOfOneBuild)
{
    std::regex const date("[A-Z][a-z]{2} [ 123][0-9] 20[0-9]{2}");
    std::regex const flavour("(opt|dbg|sanitize)\\.[a-z0-9_]+\\.(gnu|clang)");
    std::vector<InPackageInfo> const infos = InBuildInfoUtil::getInfos();
    int modules = 0;
    for (InPackageInfo const& package : infos)
    {
        ASSERT_NE(package.buildInfo, nullptr) << package.packageName;
        InBuildInfo const& info = *package.buildInfo;
        bool const isModule = package.packageName == std::string("pyextUi");
        modules += isModule;
        EXPECT_EQ(info.getLibraryName(), isModule ? "libKvpyextUi" : std::string("libKV") + package.packageName);
        EXPECT_STREQ(info.getProductName(), "Quorvane Velmora Library");
        EXPECT_STREQ(info.getReleaseYear(), "2013");
        EXPECT_STREQ(info.getVersionString(), "8.0");
        EXPECT_STREQ(info.getVersionSuffix(), "");
        EXPECT_EQ(info.getMajorVersion(), 8);
        EXPECT_EQ(info.getMinorVersion(), 0);
        EXPECT_EQ(info.getReleaseStage(), 42);
        EXPECT_STREQ(info.getBuildNumber(), "2600");
        EXPECT_TRUE(std::regex_match(info.getBuildDate(), date)) << info.getBuildDate();
        EXPECT_TRUE(std::regex_match(info.getBuildFlavour(), flavour)) << info.getBuildFlavour();
        EXPECT_STREQ(info.getBuildFlavour(), infos.front().buildInfo->getBuildFlavour());
    }
    EXPECT_EQ(modules, 1);
    EXPECT_EQ(*InInit<KvInit::pyextUi>::getType(), typeid(InInit<KvInit::pyextUi>));
}

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    Py_Initialize();
    bp::import("sys").attr("path").attr("insert")(0, KV_PACKAGE_DIR);
    int const result = RUN_ALL_TESTS();
    return Py_FinalizeEx() == 0 ? result : 1;
}
