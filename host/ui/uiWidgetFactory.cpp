#include "uiWidgetFactory.h"

#include "uiLayout.h"
#include "uiWidgetElement.h"
#include "xml/xmlError.h"

#include <cctype>
#include <map>

namespace Kv
{

namespace
{

using Builders = std::map<std::string, UiWidgetKind::Build>;

/// By the names of the elements.
Builders& getBuilders()
{
    static Builders builders;
    return builders;
}

/// The letters of a text, all of them small.
std::string toLetters(std::string const& text)
{
    std::string letters;
    for (char const character : text)
        if (std::isalpha(static_cast<unsigned char>(character)))
            letters += static_cast<char>(std::tolower(static_cast<unsigned char>(character)));
    return letters;
}

/// True if `name` may be meant for `kind`: "text_field" and "Text" may be meant for a "TextField".
bool isNear(std::string const& name, std::string const& kind)
{
    std::string const letters = toLetters(name);
    return letters.size() > 2 &&
           (toLetters(kind).find(letters) != std::string::npos || letters.find(toLetters(kind)) != std::string::npos);
}

[[noreturn]] void failUnknown(XmlElement const& element, Builders const& known)
{
    std::string words = "unknown widget element \"" + element.getName() + "\"";
    std::optional<XmlElement> const widget = element.findChild("Widget");
    if (std::optional<std::string> const name = widget ? widget->findAttribute("Name") : std::nullopt)
        words += " of the widget \"" + *name + "\"";
    std::string kinds;
    std::string meant;
    for (auto const& [kind, builder] : known)
    {
        kinds += (kinds.empty() ? "" : ", ") + kind;
        if (meant.empty() && isNear(element.getName(), kind))
            meant = " Is it \"" + kind + "\"?";
    }
    throw XmlError(__FILE__, __LINE__, element.getLine(), words + ". Known are " + kinds + "." + meant);
}

UiWidgetKind::Build findBuilder(XmlElement const& element)
{
    auto const found = getBuilders().find(element.getName());
    if (found == getBuilders().end())
        failUnknown(element, getBuilders());
    return found->second;
}

/// Takes out again what was built, unless all of it came to a good end.
class Rollback
{
public:
    explicit Rollback(RCShdPtr<UiContainer> const& container)
        : _container(container), _count(container->getChildren().size())
    {
    }
    Rollback(Rollback const&) = delete;
    Rollback& operator=(Rollback const&) = delete;

    ~Rollback()
    {
        while (!_done && _container->getChildren().size() > _count)
        {
            RCShdPtr<UiWidget> const widget = _container->getChildren().back();
            widget->clearParent();
        }
    }

    void dismiss() { _done = true; }

private:
    RCShdPtr<UiContainer> _container;
    std::size_t _count;
    bool _done = false;
};

} // namespace

UiWidgetKind::UiWidgetKind(char const* element, Build build)
{
    getBuilders().emplace(element, build);
}

RCShdPtr<UiWidget> UiWidgetFactory::createWidget(RCShdPtr<UiContainer> const& parent, XmlElement const& element)
{
    Rollback rollback(parent);
    createAll(parent, {element}, 1);
    rollback.dismiss();
    return parent->getChildren().back();
}

void UiWidgetFactory::createGroup(RCShdPtr<UiContainer> const& container, UiWidgetElement& element)
{
    if (element.getDepth() > maxDepth)
        throw XmlError(__FILE__, __LINE__, element.getLine(),
                       "containers nested deeper than " + std::to_string(maxDepth));
    createAll(container, element.takeGroup(), element.getDepth() + 1);
}

void UiWidgetFactory::createAll(RCShdPtr<UiContainer> const& container, std::vector<XmlElement> const& elements,
                                int depth)
{
    std::size_t const first = container->getChildren().size();
    for (XmlElement const& element : elements)
    {
        UiWidgetKind::Build const build = findBuilder(element);
        UiWidgetElement widget(element, depth);
        build(container, widget);
        container->getChildren().back()->setConstraint(widget.getConstraint());
        widget.finish();
    }
    if (std::optional<UiLayout::Fault> const fault = UiLayout(*container).findFault())
        throw XmlError(__FILE__, __LINE__, elements.at(fault->child - first).getLine(), fault->words);
}

} // namespace Kv
