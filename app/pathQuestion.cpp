#include "pathQuestion.h"

#include "files/osFile.h"
#include "piBrowserSchemes.h"
#include "uiAppMgr.h"
#include "uiApplication.h"

#include <filesystem>

namespace Velmora
{

PathQuestion::PathQuestion(char const* title, std::string const& place)
    : _handler(Kv::UiAppMgr::getInstance().getMainWindow()->getRootContainer(), title,
               Kv::UiAppMgr::getInstance().getSelection(), {Kv::PiBrowserSchemes::FsScheme}, place,
               Kv::Bookmarkable(1)),
      _okCb(this, &PathQuestion::onOk)
{
    _handler.getBrowser()->setDontLoadCompositions(true);
    _handler.getBrowser()->setTakesNew(false);
    _handler.setActivateCb(&_okCb);
}

std::string PathQuestion::ask()
{
    Kv::UiAppDisabler const disabler;
    _handler.getContainer()->getParent()->front(_handler.getContainer());
    _handler.show();
    Kv::UiApplication::getInstance()->localMessageLoop(_handler.isClosedConst(), _handler.isClosed());
    return _path;
}

void PathQuestion::onOk(Kv::EvEvent&)
{
    std::string const path = _handler.getBrowser()->getInputFocusPath().toString();
    if (path.empty())
        return;
    auto const kind = Kv::OsFsUtils::findKind(Kv::OsFilePath(path));
    // What does not answer is no file to be opened either.
    if (!kind || kind == std::filesystem::file_type::directory)
        return;
    _path = path;
    _handler.hide();
}

} // namespace Velmora
