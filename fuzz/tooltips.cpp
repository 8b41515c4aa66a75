// A resource of tooltips, and the name by which it is asked for: the first line of the input. The rest of the input is
// the resource's file, and then the text that such a file has for that name.

#include "fuzz.h"

#include "exBase.h"
#include "uiResTable.h"
#include "xml/xmlWriter.h"

using namespace Kv;

namespace
{

/// What can be a text, with all that XML could read in another way by its number.
std::optional<std::string> escape(std::string_view text)
{
    try
    {
        XmlWriter::requireText(std::string(text), "text");
    }
    catch (ExBase const&)
    {
        return std::nullopt;
    }
    std::string escaped;
    for (char const character : text)
        if (std::string_view("<>&'\"\t\n\r").find(character) == std::string_view::npos)
            escaped += character;
        else
            escaped += "&#" + std::to_string(character) + ';';
    return escaped;
}

void requireText(Fuzz::Folder const& folder, std::string_view name, std::string_view text)
{
    std::optional<std::string> const escapedName = escape(name);
    std::optional<std::string> const escapedText = escape(text);
    if (!escapedName || !escapedText)
        return;
    std::string const file =
        "<Tooltips><Tooltip Widget='" + *escapedName + "'>" + *escapedText + "</Tooltip></Tooltips>";
    UiResTable const table = UiResTable::load(folder.write("written.xml", file).string());
    Fuzz::require(table.findTooltip(std::string(name)) == text, "a widget's text returns");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    static Fuzz::Folder const folder;
    std::string_view const input = Fuzz::asText(data, size);
    std::string_view const name = input.substr(0, input.find('\n'));
    std::string_view const content = input.substr(std::min(input.size(), name.size() + 1));
    for (std::string const& resource :
         {std::string(name), folder.write("resource.xml", content).replace_extension().string()})
        try
        {
            UiResTable::load(resource).findTooltip(std::string(name));
        }
        catch (ExBase const& error)
        {
            Fuzz::require(error.getReason()[0] != '\0', "an error has words");
        }
    requireText(folder, name, content);
    return 0;
}
