// A resource of tooltips, and the name by which it is asked for: the first line of the input.

#include "fuzz.h"

#include "exBase.h"
#include "uiResTable.h"

using namespace Kv;

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
    return 0;
}
