#pragma once

#include "kvExport.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace Kv
{

/// What a widget is to the user.
enum class IdKind
{
    Label,
    Field,
    Toggle,
    Menu,
    List,
    Button,
};

/// A widget of a dialog, as the user sees it.
struct IdWidget
{
    IdKind kind = IdKind::Label;
    std::string name;
    /// The words on a button, or those beside a widget that holds a value. Empty where there are none.
    std::string caption;
    /// The text of a label or field, the selected entry of a menu.
    std::string text;
    bool isOn = false;
    bool isShown = false;
    bool isEnabled = false;
    bool hasKeyboard = false;
};

/// Lets a test be the user: tells what stands on the screen, types and clicks. All of it is about one dialog, the one
/// that takes input. Keys and clicks go to its window, and take their way from there as a user's do. For the thread of
/// the user interface.
class KV_API InputDoor
{
public:
    static InputDoor& getInstance();

    /// From here on the function is called again and again while a dialog runs that has begun since, and each time that
    /// another one runs inside the call. What it throws comes out of the innermost run. Starts the user interface.
    /// Throws an `ExBase` where that cannot have windows, and where the door is open already.
    void open(std::function<void()> onTurn);
    void close();

    /// The title of the dialog; nothing where none takes input.
    std::optional<std::string> getTitle() const;

    /// The widgets of the dialog as the eye goes, row by row from the top. In what follows a widget is its place here.
    std::vector<IdWidget> look();

    /// The reason why the user cannot click on the widget, after a verb; empty where he can. Scrolls it into view.
    std::string getObstacle(std::size_t widget);

    void click(std::size_t widget);

    /// The entries of a menu, or the rows of a list.
    std::vector<std::string> getEntries(std::size_t widget) const;

    /// Opens the menu and picks an entry, or clicks on a row; with `isMore` the other selected rows stay so.
    void pick(std::size_t widget, int entry, bool isMore);

    /// Types the text, in which a line break is Enter and a tabulator Tab.
    void type(std::string const& text);

    /// Presses a key by its name, such as "Escape", "Shift+Tab" or "Ctrl+A". False for what is none.
    bool press(std::string const& key);

    /// Saves a picture of the dialog, of the kind that the path's suffix says. False where that fails.
    bool takePicture(std::string const& path) const;

    /// Closes a dialog of Qt's own that is run by others. False where none takes input.
    bool closeForeign();

private:
    InputDoor();
    ~InputDoor();
    void turn();

    struct Parts;
    std::unique_ptr<Parts> _parts;
};

} // namespace Kv
