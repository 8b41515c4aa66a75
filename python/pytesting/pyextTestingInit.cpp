#include <boost/python.hpp>

#include "inputDoor.h"
#include "pyModule.h"

namespace bp = boost::python;

namespace Kv::PyextTesting
{

namespace
{

InputDoor& getDoor()
{
    return InputDoor::getInstance();
}

template <typename Item> bp::list toList(std::vector<Item> const& items)
{
    bp::list result;
    for (Item const& item : items)
        result.append(item);
    return result;
}

void open(bp::object const& onTurn)
{
    getDoor().open([onTurn] { onTurn(); });
}

void close()
{
    getDoor().close();
}

bp::object getTitle()
{
    std::optional<std::string> const title = getDoor().getTitle();
    return title ? bp::object(*title) : bp::object();
}

bp::list look()
{
    return toList(getDoor().look());
}

std::string getObstacle(std::size_t widget)
{
    return getDoor().getObstacle(widget);
}

void click(std::size_t widget)
{
    getDoor().click(widget);
}

bp::list getEntries(std::size_t widget)
{
    return toList(getDoor().getEntries(widget));
}

void pick(std::size_t widget, int entry, bool isMore)
{
    getDoor().pick(widget, entry, isMore);
}

void type(std::string const& text)
{
    getDoor().type(text);
}

bool press(std::string const& key)
{
    return getDoor().press(key);
}

bool takePicture(std::string const& path)
{
    return getDoor().takePicture(path);
}

bool closeForeign()
{
    return getDoor().closeForeign();
}

void registerKind()
{
    if (PyextInit::shareClass<IdKind>("Kind"))
        return;
    bp::enum_<IdKind>("Kind")
        .value("LABEL", IdKind::Label)
        .value("FIELD", IdKind::Field)
        .value("TOGGLE", IdKind::Toggle)
        .value("MENU", IdKind::Menu)
        .value("LIST", IdKind::List)
        .value("BUTTON", IdKind::Button);
}

void registerWidget()
{
    if (PyextInit::shareClass<IdWidget>("Widget"))
        return;
    bp::class_<IdWidget>("Widget", bp::no_init)
        .def_readonly("kind", &IdWidget::kind)
        .def_readonly("name", &IdWidget::name)
        .def_readonly("caption", &IdWidget::caption)
        .def_readonly("text", &IdWidget::text)
        .def_readonly("isOn", &IdWidget::isOn)
        .def_readonly("isShown", &IdWidget::isShown)
        .def_readonly("isEnabled", &IdWidget::isEnabled)
        .def_readonly("hasKeyboard", &IdWidget::hasKeyboard);
}

void moduleBody()
{
    registerKind();
    registerWidget();
    bp::def("open", &open);
    bp::def("close", &close);
    bp::def("getTitle", &getTitle);
    bp::def("look", &look);
    bp::def("getObstacle", &getObstacle);
    bp::def("click", &click);
    bp::def("getEntries", &getEntries);
    bp::def("pick", &pick);
    bp::def("type", &type);
    bp::def("press", &press);
    bp::def("takePicture", &takePicture);
    bp::def("closeForeign", &closeForeign);
}

} // namespace

} // namespace Kv::PyextTesting

extern "C" KV_API PyObject* PyInit_libKVpyextTesting()
{
    return Kv::PyextInit::initModule<&Kv::PyextTesting::moduleBody>("libKVpyextTesting");
}
