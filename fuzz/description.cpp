// The description of a dialog: read, built and shown in a window, and gone again. Whatever the text is, it gives
// widgets or an error in words.

#include "fuzz.h"
#include "window.h"

#include "uiWidgetFactory.h"
#include "xml/xmlDocument.h"
#include "xml/xmlWriter.h"

#include <fuzzer/FuzzedDataProvider.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <sstream>
#include <unordered_map>

using namespace Kv;

namespace
{

constexpr std::uint8_t authorMark = 1;

/// Writes descriptions, most of which are right.
class Author
{
public:
    Author(std::uint8_t const* data, std::size_t size) : _bytes(data, size) {}

    std::string write()
    {
        writeWidget(0);
        return _stream.str();
    }

private:
    char const* pick(std::initializer_list<char const*> words)
    {
        return words.begin()[_bytes.ConsumeIntegralInRange<std::size_t>(0, words.size() - 1)];
    }

    /// One time in thirty, and not once the bytes are used up.
    bool isRare() { return _bytes.ConsumeIntegral<std::uint8_t>() > 247; }

    std::string makeText()
    {
        std::string text = _bytes.ConsumeRandomLengthString(64);
        try
        {
            XmlWriter::requireText(text, "text");
            return text;
        }
        catch (ExBase const&)
        {
            return "text";
        }
    }

    std::string makeNumber()
    {
        if (isRare())
            return makeText();
        int const number = _bytes.ConsumeIntegralInRange(-100, 100);
        return isRare() ? std::to_string(number) + "000000000" : std::to_string(number);
    }

    std::string makeName()
    {
        return isRare() ? makeText() : pick({"A", "B", "C", "D", "CloseButton_A", "CloseButton_B"});
    }

    void writeAttribute(char const* name, std::string const& value)
    {
        if (!isRare())
            _writer.writeAttrib(name, value);
    }

    void writeEdge(char const* name)
    {
        _writer.openTag(name);
        writeAttribute("Value", makeNumber());
        writeAttribute("Type", pick({"u", "uu"}));
        bool const isAcross = *name == 'X';
        bool const isHigh = name[1] == '2';
        std::string const target = isRare()   ? makeText()
                                   : isAcross ? pick({isHigh ? "w" : "l", "l", "r", "s"})
                                              : pick({isHigh ? "h" : "b", "b", "t", "s"});
        writeAttribute("Target", target);
        if (target == "s")
            writeAttribute("Sibling", makeName());
        _writer.closeTag();
    }

    void writeInner(char const* outer, char const* inner, std::string const& text)
    {
        _writer.openTag(outer);
        do
            _writer.writeTag(inner, text);
        while (isRare());
        _writer.closeTag();
    }

    void writeProperties(std::string_view widgetKind)
    {
        _writer.openTag("Layout");
        _writer.openTag("Constraint");
        for (char const* const edge : {"X1", "Y1", "X2", "Y2"})
            if (!isRare())
                writeEdge(edge);
        _writer.closeTag();
        _writer.closeTag();
        std::string_view const kind = isRare() ? "Menu" : widgetKind;
        if (kind == "ToggleButton")
            writeInner("State", "Int", makeNumber());
        else if (kind == "Menu")
        {
            writeInner("MenuString", "Text", makeText());
            writeInner("Selection", "Int", makeNumber());
        }
        else if (kind != "Container")
            writeInner("LabelString", "Text", makeText());
        if (kind != "Container" && _bytes.ConsumeBool())
            writeAlign();
    }

    void writeAlign()
    {
        _writer.openTag("LabelAlign");
        _writer.openTag("Align");
        writeAttribute("H", pick({"Left", "Center"}));
        writeAttribute("V", isRare() ? makeText() : "Center");
        _writer.closeTag();
        _writer.closeTag();
    }

    void writeWidget(int depth)
    {
        char const* const kind = depth < 2 && _bytes.ConsumeBool()
                                     ? "Container"
                                     : pick({"Container", "Label", "TextField", "PushButton", "ToggleButton", "Menu"});
        _writer.openTag(kind);
        _writer.openTag("Widget");
        writeAttribute("Name", makeName());
        writeProperties(kind);
        _writer.closeTag();
        if (kind == std::string_view("Container"))
        {
            _writer.openTag("Group");
            writeAttribute("Type", "Children");
            while (_bytes.remaining_bytes() > 0 && _bytes.ConsumeIntegral<std::uint8_t>() > 32)
                writeWidget(depth + 1);
            _writer.closeTag();
        }
        _writer.closeTag();
    }

    FuzzedDataProvider _bytes;
    std::ostringstream _stream;
    XmlWriter _writer{_stream, 1};
};

std::string makeDescription(std::uint8_t const* data, std::size_t size)
{
    bool const isAuthored = size > 0 && *data == authorMark;
    return isAuthored ? Author(data + 1, size - 1).write() : std::string(Fuzz::asText(data, size));
}

/// Every name leads to a widget that has it.
void requireNames(UiContainer const& root, UiContainer const& container)
{
    for (RCShdPtr<UiWidget> const& child : container.getChildren())
    {
        Fuzz::require(root.findWidget(child->getName())->getName() == child->getName(), "a name leads to its widget");
        if (auto const* const inner = dynamic_cast<UiContainer const*>(&*child))
            requireNames(root, *inner);
    }
}

/// Every edge stands where its constraint says, beside what it is measured from; half a pixel is rounded on both sides.
void requirePlaces(UiContainer const& container)
{
    constexpr float limit = 1 << 23;
    GeRectangle<int> const frame = container.getFrame();
    std::unordered_map<std::string, UiWidget const*> siblings;
    for (RCShdPtr<UiWidget> const& child : container.getChildren())
        siblings.emplace(child->getName(), child.get());
    auto const at = [](GeRectangle<int> const& rect, int edge) {
        return std::array{rect.xMin, rect.yMin, rect.xMax, rect.yMax}.at(static_cast<std::size_t>(edge % 4));
    };
    for (RCShdPtr<UiWidget> const& child : container.getChildren())
    {
        for (int edge = 0; edge < UiConstraint::EdgeCount && child->getConstraint(); ++edge)
        {
            auto const& where = child->getConstraint()->getEdge(static_cast<UiConstraint::EdgeName>(edge));
            auto const isFrom = [&](UiConstraint::Target target) { return where.target == target; };
            int const base = isFrom(UiConstraint::ParentLow)    ? at(frame, edge % 2)
                             : isFrom(UiConstraint::ParentHigh) ? at(frame, edge % 2 + 2)
                             : isFrom(UiConstraint::OwnOpposite)
                                 ? at(child->getRect(), edge + 2)
                                 : at(siblings.at(where.sibling.toString())->getRect(), edge + 2);
            float const sign = isFrom(UiConstraint::OwnOpposite) && edge < 2 ? -1 : 1;
            float const place = std::clamp(static_cast<float>(base) + sign * where.getPixels(), -limit, limit);
            Fuzz::require(std::fabs(place - static_cast<float>(at(child->getRect(), edge))) <= 1,
                          "an edge is where its constraint says");
        }
        if (auto const* const inner = dynamic_cast<UiContainer const*>(child.get()))
            requirePlaces(*inner);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    RCShdPtr<UiTopLevel> const window = Fuzz::makeWindow();
    RCShdPtr<UiContainer> const root = window->getRootContainer();
    try
    {
        RCShdPtr<XmlElement> const element = XmlDocument(makeDescription(data, size)).getRoot();
        if (element.isNull())
            return 0;
        UiWidgetFactory::createWidget(root, *element);
    }
    catch (ExBase const& error)
    {
        Fuzz::require(error.getReason()[0] != '\0', "an error has words");
        Fuzz::require(root->getChildren().empty(), "nothing is left of a description that is refused");
        return 0;
    }
    requireNames(*root, *root);
    window->display(true);
    window->redraw();
    requirePlaces(*root);
    window->display(false);
    return 0;
}
