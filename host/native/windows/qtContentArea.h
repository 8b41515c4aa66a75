#pragma once

#include <QPointer>
#include <QScrollArea>

#include <functional>

namespace Kv
{

/// Scrolls a content where that is larger than the room, and says how much room there is.
class QtContentArea final : public QScrollArea
{
public:
    /// `onRoom` hears of the width and height in pixels, and gives whether all has its place there; it may end the
    /// area.
    QtContentArea(QWidget* parent, std::function<bool(int, int)> onRoom);
    ~QtContentArea() override;

    /// Takes that place in the parent, and tells the room.
    void fill(QRect const& place);

    /// Tells the room if it is another than was told last. Before the area is shown that is the room that it will have.
    void tellRoom();

    /// Gives the content its size, in pixels, once all in it has its place.
    void setContentSize(int width, int height);

    /// Notices from now on whether somebody reads the screen to the user.
    static void noticeReaders();

    /// The widgets in the content are called anew by what stands beside them, once the event that is handled is over.
    /// Nothing happens before somebody reads the screen to the user.
    void nameValuesSoon();

    /// The room is told anew, whatever it was.
    void forgetRoom() { _told = QSize(); }

    /// `cover`, borrowed, is not in the content, and lies over the upper edge of what is seen of that.
    void setCover(QWidget& cover) { _cover = &cover; }

private:
    void setBars(bool below, bool beside);
    void turnPage(int action);

    std::function<bool(int, int)> _onRoom;
    QSize _told;
    QPointer<QWidget> _cover;
    bool _telling = false;
    bool _naming = false;
};

} // namespace Kv
