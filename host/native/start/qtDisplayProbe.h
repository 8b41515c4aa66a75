#pragma once

#include <QMap>
#include <QString>

#include <memory>
#include <string>

struct xcb_connection_t;

namespace Kv
{

/// Platform that a QApplication can be started on without ending the process, or the words why there is none.
struct DisplayChoice
{
    /// Name with its parameters, as Qt's "-platform" argument takes it; empty where there is none.
    QString platform;

    /// The reason why windows cannot be shown, and what to set; empty where they can.
    std::string refusal;
};

/// Looks for a window system before Qt does: Qt ends the process where it finds none. Has to live until Qt has started:
/// a server whose only client leaves can reset itself and refuse the next one meanwhile.
class QtDisplayProbe
{
public:
    QtDisplayProbe();

    /// The platform that the user's settings ask for, else the one whose display answers.
    DisplayChoice choose();

    /// True if a platform plugin of that name is there and loads; `refusal` tells why not.
    bool canLoad(QString const& name, std::string& refusal) const;

private:
    DisplayChoice chooseAsked(QString const& asked);
    DisplayChoice chooseAnswering();
    bool isUsable(QString const& platform, std::string& refusal);

    /// True if what the platform draws on is there; platforms that draw on nothing outside the process are always fine.
    bool answers(QString const& platform, std::string& refusal);
    bool answersX11(std::string& refusal);

    /// Plugin file of each platform, by lower-case name.
    QMap<QString, QString> _plugins;

    /// Open while this lives, once the display has answered.
    std::shared_ptr<xcb_connection_t> _display;
};

} // namespace Kv
