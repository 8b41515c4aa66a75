#include "files/osAsync.h"
#include "files/osFile.h"
#include "refusals.h"
#include "text/liString.h"
#include "text/liStringSubstituter.h"
#include "xml/xmlDocument.h"
#include "xml/xmlError.h"
#include "xml/xmlWriter.h"

#include <atomic>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <functional>
#include <future>
#include <gtest/gtest.h>
#include <iterator>
#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include <sys/wait.h>
#include <unistd.h>

using namespace Kv;
using namespace std::string_literals;

namespace
{

constexpr int maximumDepth = 1024;

std::string repeated(int count, std::string const& text)
{
    std::string result;
    for (int i = 0; i < count; ++i)
        result += text;
    return result;
}

XmlElement rootOf(std::string const& text)
{
    return *XmlDocument(text).getRoot();
}

void expectRefused(std::string const& text, int line, std::string const& words)
{
    SCOPED_TRACE(LiStringUtil::getPrintable(text));
    try
    {
        XmlDocument const document(text);
        ADD_FAILURE() << "nothing was refused";
    }
    catch (XmlError const& error)
    {
        EXPECT_EQ(error.getLine(), line) << error.what();
        expectContains(error.what(), "line " + std::to_string(line) + ": ");
        expectContains(error.what(), words);
        EXPECT_TRUE(LiStringUtil::isUtf8(error.what()));
    }
}

class Handler : public CbHandler<std::string>
{
public:
    explicit Handler(std::function<void(std::string&)> replace) : _replace(std::move(replace)) {}
    void call(std::string& text) override { _replace(text); }

private:
    std::function<void(std::string&)> _replace;
};

} // namespace

TEST(XmlWriter, IsReadBackExactly)
{
    std::vector<std::string> const texts(
        {"", " ", "\n\t ", "\r", "\r\n", " a\r\n\tb ", "<>&\"'", "&amp;&#10;&", "]]>", "<!-- -->", "<![CDATA[x]]>",
         "<?xml?>", "\xef\xbb\xbfmark", "\x7f\xc2\x80\xc2\x85\xe2\x80\xa8",
         "\xc3\xb6 \xe2\x82\xac \xf0\x9f\x98\x80\xef\xbf\xbd", repeated(100000, "&<\r")});
    std::ostringstream stream;
    XmlWriter writer(stream, 3);
    writer.openTag("\xc3\x84ste.1-:_");
    for (std::string const& text : texts)
    {
        writer.openTag("Group");
        writer.writeAttrib("a", text);
        writer.writeAttrib("\xc3\xa9", text);
        writer.writeTag("Text", text);
        writer.closeTag();
    }
    writer.closeTag();

    XmlElement const root = rootOf(stream.str());
    EXPECT_EQ(root.getName(), "\xc3\x84ste.1-:_");
    std::vector<XmlElement> const groups = root.getChildren();
    ASSERT_EQ(groups.size(), texts.size());
    for (std::size_t i = 0; i < texts.size(); ++i)
    {
        SCOPED_TRACE(LiStringUtil::getPrintable(texts[i]));
        EXPECT_EQ(groups[i].getAttributeNames(), (std::vector<std::string>{"a", "\xc3\xa9"}));
        EXPECT_EQ(groups[i].getAttribute("a"), texts[i]);
        EXPECT_EQ(groups[i].getAttribute("\xc3\xa9"), texts[i]);
        EXPECT_EQ(groups[i].findChild("Text")->getText(), texts[i]);
    }
}

TEST(XmlWriter, RefusesWhatXmlCannotHoldAndGoesOnAsBefore)
{
    std::ostringstream stream;
    XmlWriter writer(stream, 1);
    writer.openTag("Root");
    writer.writeAttrib("a", 1);
    std::string const before = stream.str();

    for (std::string const& text : {"a\0b"s, "\x01"s, "\x1f"s, "\xff"s, "\xc3"s, "\xc0\x80"s, "\xed\xa0\x80"s,
                                    "\xef\xbf\xbe"s, "\xef\xbf\xbf"s, "\xf4\x90\x80\x80"s})
    {
        SCOPED_TRACE(LiStringUtil::getPrintable(text));
        expectContains(wordsOf<XmlError>([&] { writer.writeAttrib("b", text); }), LiStringUtil::getPrintable(text));
        expectContains(wordsOf<XmlError>([&] { writer.writeTag("Text", text); }), LiStringUtil::getPrintable(text));
    }
    for (std::string const& name :
         {""s, "a b"s, "1"s, "-a"s, "a<"s, "a\0"s, "a\n"s, "a=''"s, "\xff"s, "\xc3\x97"s, "\xf0\x90\x80\x80"s})
    {
        SCOPED_TRACE(LiStringUtil::getPrintable(name));
        expectContains(wordsOf<XmlError>([&] { writer.openTag(name); }), LiStringUtil::getPrintable(name));
        expectContains(wordsOf<XmlError>([&] { writer.writeTag(name, 1); }), LiStringUtil::getPrintable(name));
        expectContains(wordsOf<XmlError>([&] { writer.writeAttrib(name, 1); }), LiStringUtil::getPrintable(name));
    }
    expectContains(wordsOf<XmlError>([&] { writer.writeAttrib("a", 2); }), "twice");

    EXPECT_EQ(stream.str(), before);
    writer.writeAttrib("b", 2);
    writer.closeTag();
    expectContains(wordsOf<XmlError>([&] { writer.openTag("Other"); }), "second root");
    EXPECT_EQ(stream.str(), "<Root a=\"1\" b=\"2\"/>\n");
}

TEST(XmlWriter, RefusesCallsThatGiveNoDocument)
{
    std::ostringstream stream;
    XmlWriter writer(stream, 0);
    expectContains(wordsOf<XmlError>([&] { writer.closeTag(); }), "no open element");
    expectContains(wordsOf<XmlError>([&] { writer.writeAttrib("a", 1); }), "'a'");
    writer.openTag("Root");
    writer.writeTag("Text", "");
    expectContains(wordsOf<XmlError>([&] { writer.writeAttrib("a", 1); }), "'a'");
    writer.closeTag();
    expectContains(wordsOf<XmlError>([&] { writer.closeTag(); }), "no open element");
    expectContains(wordsOf<XmlError>([&] { writer.openTag("Other"); }), "second root");
    expectContains(wordsOf<XmlError>([&] { writer.writeTag("Other", 1); }), "second root");
    EXPECT_EQ(stream.str(), "<Root>\n<Text/>\n</Root>\n");

    std::ostringstream broken;
    broken.setstate(std::ios::badbit);
    expectContains(wordsOf<XmlError>([&] { XmlWriter(broken, 0).openTag("Root"); }), "stream");
    expectContains(wordsOf<XmlError>([&] { XmlWriter(stream, -1); }), "-1");
}

TEST(XmlDocument, GivesElementsWithTheirLinesThatOutliveIt)
{
    XmlElement const root = rootOf("\xef\xbb\xbf<?xml version='1.0' encoding=\"utf-8\"?>\r\n<!-- a -->\r<Root>\n"
                                   "  <A x='1'\n y=\"2\"/><?skip <this> ?><B> <!--c--></B>text\n <A/></Root>\n");
    EXPECT_EQ(root.getLine(), 3);
    std::vector<XmlElement> const children = root.getChildren();
    ASSERT_EQ(children.size(), 3U);
    EXPECT_EQ(children[0].getLine(), 4);
    EXPECT_EQ(children[1].getLine(), 5);
    EXPECT_EQ(children[2].getLine(), 6);
    EXPECT_EQ(root.findChild("A")->getAttribute("y"), "2");
    EXPECT_FALSE(root.findChild("C"));
    EXPECT_FALSE(children[2].findAttribute("x"));
    EXPECT_EQ(wordsOf<XmlError>([&] { children[2].getAttribute("x"); }), "line 6: element 'A' has no attribute 'x'");
    EXPECT_TRUE(root.hasText());
    EXPECT_EQ(children[1].getText(), " ");
    EXPECT_FALSE(children[1].hasText());
}

TEST(XmlDocument, DecodesReferencesAndLineEnds)
{
    XmlElement const root = rootOf("<a b='&lt;&amp;lt;&#x20AC;&#9;&#10;\t\r\n\r\n&apos;&#0065;'>"
                                   "\r\n1\r2&#13;\n&quot;&gt;]]<!-- & --> <![CDATA[&amp;\r\n<]]>&#x1F600;</a>");
    EXPECT_EQ(root.getAttribute("b"), "<&lt;\xe2\x82\xac\t\n   'A");
    EXPECT_EQ(root.getText(), "\n1\n2\r\n\">]] &amp;\n<\xf0\x9f\x98\x80");
}

TEST(XmlDocument, RefusesWhatIsNotOneWholeElement)
{
    expectRefused("hello", 1, "text outside of the root element: 'hello");
    expectRefused("x", 1, "text outside");
    expectRefused("<a/>\n x", 2, "text outside");
    expectRefused("<a/>\n&#32;", 2, "text outside");
    expectRefused("\n<![CDATA[]]><a/>", 2, "text outside");
    expectRefused("\xef\xbb\xbf\xef\xbb\xbf<a/>", 1, "byte order mark");
    expectRefused("\n'x\ny", 2, "text outside");
    expectRefused("<a/>\n<b/>", 2, "second root element: 'b'");
    expectRefused("<a>\n<b>\n<c>\n</b>", 4, "element 'c' of line 3 is not closed");
    for (char const* const text : {"<", "\n <", "<a", "<a>", "<a/", "<a></b>", "</a>", "<a></a", "<a/><", "<a/> <",
                                   "<a><b></a></b>", "<!-- a", "<a><![CDATA[x</a>", "<a><?p</a>"})
        expectRefused(text, text[0] == '\n' ? 2 : 1, "no well-formed XML");
}

TEST(XmlDocument, RefusesMalformedMarkup)
{
    for (char const* const text : {"\n<a b/>", "\n<a b=1/>", "\n<a b='1'c='2'/>", "\n<a b='1/>", "\n< a/>", "\n<1/>",
                                   "\n<a></a b>", "\n<a>< b/></a>", "\n<a/ >", "\n<!a>"})
        expectRefused(text, 2, "no well-formed XML");
    expectRefused("<a b='1'\nc='2'\nb='3'/>", 3, "'b' stands twice in element 'a'");
    expectRefused("<a b='\n<'/>", 2, "'<' inside an attribute");
    expectRefused("<a>\n]]></a>", 2, "']]>' inside a text");
    expectRefused("<a>\n<!-- -- --></a>", 2, "'--' inside a comment");
    expectRefused("<!--\n--->", 2, "comment that ends");
    expectRefused("<a>\n<\xc3\x97/></a>", 2, "no XML name: '\xc3\x97'");
    expectRefused("<a\n\xc3\x97='1'/>", 2, "no XML name: '\xc3\x97'");
    expectRefused("\n<?\xc3\x97?><a/>", 2, "no XML name: '\xc3\x97'");
    expectRefused("\n<!DOCTYPE a [<!ENTITY b 'c'>]><a>&b;</a>", 2, "DOCTYPE");
}

TEST(XmlDocument, RefusesForbiddenCharactersAndReferences)
{
    expectRefused("<a>\n\xff</a>", 2, "not valid UTF-8: '<a>\\n\\xff</a>'");
    expectRefused("<a>\r\xed\xa0\x80</a>", 2, "not valid UTF-8");
    expectRefused("<a/>\r\n\0"s, 2, "cannot hold");
    expectRefused("<a b='\n\x01'/>", 2, R"(cannot hold: '<a b=\'\n\x01\'/>')");
    expectRefused("<!--\xef\xbf\xbf--><a/>", 1, "cannot hold");
    expectRefused("<a>&go;</a>", 1, "&go;");
    for (std::string const reference :
         {"&#0;",  "&#1;", "&#x1f;", "&#xD800;", "&#xFFFE;", "&#x110000;", "&#99999999999;",
          "&#;",   "&#x;", "&#X41;", "&#-1;",    "&#4 1;",   "&#65x;",     "&foo;",
          "&AMP;", "&;",   "&",      "& ",       "&amp",     "&&amp;"})
    {
        expectRefused("<a>\n" + reference + "</a>", 2, "reference");
        expectRefused("<a b='\n" + reference + "'/>", 2, "reference");
    }
}

TEST(XmlDocument, ReadsTheEncodingsThatItsParserKnows)
{
    std::string const utf8 = "<a b='\xc3\xa9'>\xe2\x82\xac</a>";
    std::string wide;
    for (char16_t const unit : u"\ufeff<a b='\u00e9'>\u20ac</a>"s)
        wide.append({static_cast<char>(unit & 0xff), static_cast<char>(unit >> 8)});
    for (std::string const& text : {utf8, wide})
        EXPECT_EQ(rootOf(text).getAttribute("b") + rootOf(text).getText(), "\xc3\xa9\xe2\x82\xac");
    EXPECT_EQ(rootOf("<?xml version='1.0' encoding='iso-8859-1'?><a>\xe9</a>").getText(), "\xc3\xa9");
    expectRefused("<?xml version='1.0' encoding='iso-8859-1'?>" + utf8, 1, "'iso-8859-1', but is UTF-8");
    expectRefused("<?xml version='1.0' encoding='utf-16'?>" + utf8, 1, "declares: 'utf-16'");
    expectRefused("<?xml version='1.0' encoding='us-ascii'?>\n" + utf8, 2, "in the encoding 'us-ascii'");
}

TEST(XmlDocument, TakesOnlyDeclarationsOfItsEncodings)
{
    for (char const* const rest : {"version='1.0'", R"(version="1.1" )", "version='1.0' encoding='US-ascii'",
                                   "version = '1.0'\nencoding = 'Utf-8' standalone='no'"})
        EXPECT_EQ(rootOf("<?xml "s + rest + "?><a/>").getName(), "a") << rest;
    expectRefused("<?xml version='1.0' encoding='latin-1'?><a/>", 1, "not UTF-8 but 'latin-1'");
    for (char const* const rest :
         {"", " ", " encoding='utf-8'", " version='2.0'", " version='1.'", " version='1.0'>",
          " version='1.0' standalone='yes' encoding='utf-8'", " version='1.0' a='b'",
          " version='1.0' standalone='maybe'", " version='1.0'></xml><b", " version='1.0' encoding='&#117;tf-8'"})
        expectRefused("<?xml"s + rest + "?><a/>", 1, "XML declaration");
    expectRefused("<?xml version='1.0'", 1, "not closed");
    expectRefused("\n<?xml version='1.0'?><a/>", 2, "not the first thing");
    expectRefused("<a/>\n<?XML version='1.0'?>", 2, "not the first thing");
}

TEST(XmlLimits, ReaderAndWriterStopAtTheSameDepth)
{
    std::ostringstream stream;
    XmlWriter writer(stream, 1);
    for (int i = 0; i < maximumDepth; ++i)
        writer.openTag("a");
    expectContains(wordsOf<XmlError>([&] { writer.openTag("a"); }), "1024");
    expectContains(wordsOf<XmlError>([&] { writer.writeTag("a", 1); }), "1024");
    for (int i = 0; i < maximumDepth; ++i)
        writer.closeTag();

    int depth = 0;
    for (std::optional<XmlElement> element = rootOf(stream.str()); element; element = element->findChild("a"))
        EXPECT_EQ(element->getLine(), ++depth);
    EXPECT_EQ(depth, maximumDepth);

    expectRefused(repeated(maximumDepth + 1, "<a>\n") + repeated(maximumDepth + 1, "</a>"), maximumDepth + 1, "1024");
    expectRefused(repeated(100000, "<a>") + repeated(100000, "</a>"), 1, "1024");
    expectRefused(repeated(100000, "<a>"), 1, "1024");
}

TEST(XmlLimits, LargeDocumentsCostWhatTheyHold)
{
    constexpr int rows = 200000;
    XmlElement const root = rootOf("<a>\n" + repeated(rows, "<b c='&amp;'>&lt;</b>\n") + "</a>");
    int line = 1;
    for (XmlElement const& child : root.getChildren())
    {
        ASSERT_EQ(child.getLine(), ++line);
        ASSERT_EQ(child.getAttribute("c") + child.getText(), "&<");
    }
    EXPECT_EQ(line, rows + 1);

    std::string wide = "<a";
    for (int i = 0; i < rows; ++i)
        wide += "\nb" + std::to_string(i) + "=''";
    EXPECT_EQ(rootOf(wide + "/>").getAttributeNames().size(), static_cast<std::size_t>(rows));
    expectRefused(wide + "\nb7=''/>", rows + 2, "'b7' stands twice");

    std::string const much = repeated(rows, " a value, a comment and a text that go on and on");
    XmlElement const element = rootOf("<a b='" + much + "'><!--" + much + "-->" + much + "</a>");
    EXPECT_TRUE(element.getAttribute("b") == much && element.getText() == much);
}

TEST(LiStringSubstituter, ReplacesEveryOccurrenceOnce)
{
    int calls = 0;
    Handler counting([&](std::string& text) { text += std::to_string(++calls); });
    Handler fixed([](std::string& text) { text = "-999"; });
    Handler empty([](std::string& text) { text = ""; });
    LiStringSubstituter substituter;
    EXPECT_EQ(substituter.substitute("-999"), "-999");
    substituter.add("-999", &counting);
    substituter.add("-888", &fixed);
    substituter.add("-8", &empty);
    substituter.add("-88", &fixed);
    EXPECT_EQ(substituter.substitute(""), "");
    EXPECT_EQ(substituter.substitute("--999-99-888x-889-999-999"), "--9991-99-999x89-9992-9993");

    LiStringSubstituter overlapping;
    overlapping.add("aa", &empty);
    overlapping.add("a\0b"s, &fixed);
    EXPECT_EQ(overlapping.substitute("aaa a\0b"s), "a -999");

    expectContains(wordsOf([&] { substituter.add("", &fixed); }), "empty");
    expectContains(wordsOf([&] { substituter.add("x", nullptr); }), "'x'");
}

TEST(LiStringUtil, NamesAndShowsATextThatIsNoUtf8)
{
    EXPECT_NO_THROW(LiStringUtil::requireUtf8("\xe2\x82\xac", "Label"));
    EXPECT_EQ(wordsOf([] { LiStringUtil::requireUtf8("a'\n\xffg", "Label"); }),
              "Label: not valid UTF-8: 'a\\'\\n\\xffg'");
    expectContains(wordsOf([] { LiStringUtil::requireUtf8("a\0b"s, "Label"); }), "'a\\x00b'");

    std::string const bad = repeated(1000, "\xe2\x82\xac") + "\xe2\x82" + std::string(1000, 'x');
    std::string const words = wordsOf([&] { LiStringUtil::requireUtf8(bad, "Label"); });
    expectContains(words, "\xe2\x82\xac\\xe2\\x82xx");
    expectContains(words, "Label: not valid UTF-8: '...\xe2\x82\xac");
    EXPECT_TRUE(LiStringUtil::isUtf8(words));
    EXPECT_LT(words.size(), 200U);
}

TEST(OsFile, TellsSizesAndNamesWhatHasNone)
{
    std::string const folder = testing::TempDir();
    std::string const path = folder + "resmgtTest.txt";
    std::ofstream(path) << "12345";
    EXPECT_EQ(OsFile(OsFilePath(path)).getSize(), 5U);
    EXPECT_EQ(std::remove(path.c_str()), 0);
    expectContains(wordsOf([&] { OsFile(OsFilePath(path)).getSize(); }), path);
    expectContains(wordsOf([&] { OsFile(OsFilePath(folder)).getSize(); }), folder);
    EXPECT_THROW(OsFile(OsFilePath()).getSize(), ExBase);
}

TEST(OsAsync, LeavesFewThreadsBehindWhatIsSilentAndDoesAllOnceThereIsAnAnswer)
{
    auto const countThreads = []
    {
        return std::distance(std::filesystem::directory_iterator("/proc/self/task"),
                             std::filesystem::directory_iterator());
    };
    auto const waitUntil = [](auto const& condition)
    {
        while (!condition())
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
    };
    std::promise<void> answer;
    std::shared_future<void> const answered = answer.get_future().share();
    std::atomic<int> done = 0;
    auto const ask = [&](std::string const& path, bool isCancelled)
    {
        auto const work = [&]
        {
            answered.wait();
            ++done;
        };
        OsAsync::start(path, work, std::make_shared<std::atomic<bool>>(isCancelled));
    };
    auto const before = countThreads();
    ask("/dead", false);
    waitUntil([] { return OsAsync::isSilent("/dead/deep"); });
    EXPECT_FALSE(OsAsync::isSilent("/deadly"));
    for (int number = 0; number < 100; ++number)
    {
        ask("/dead", number % 2);
        ask("/dead/" + std::to_string(number), number % 2);
    }
    EXPECT_LT(countThreads(), before + 5);
    EXPECT_FALSE(OsAsync::ask("/dead/deep", [] { return 1; }));
    EXPECT_EQ(OsAsync::ask("/alive", [] { return 2; }), 2);
    EXPECT_THROW(OsAsync::ask("/alive", []() -> int { throw ExBase(__FILE__, __LINE__, "none"); }), ExBase);

    for (int number = 0; number < 100; ++number)
        ask("/other" + std::to_string(number), false);
    EXPECT_LT(countThreads(), before + 40);
    EXPECT_FALSE(OsAsync::ask("/alive", [] { return 3; }));
    // A forked process has nothing to wait for.
    pid_t const child = fork();
    if (child == 0)
        _exit(OsAsync::ask("/dead", [] { return 4; }).value_or(0));
    int status = 0;
    waitpid(child, &status, 0);
    EXPECT_EQ(WEXITSTATUS(status), 4);
    answer.set_value();
    waitUntil([&] { return done == 201; });
    waitUntil([&] { return countThreads() < before + 5; });
}
