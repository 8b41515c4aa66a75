#pragma once

#include <QMap>
#include <QString>

#include <string>

namespace Kv
{

/// Platform that a QApplication can be started on without ending the process, or the words why there is none.
struct DisplayChoice
{
    /// Name with its parameters, as the toolkit's "-platform" argument takes it; empty where there is none.
    QString platform;

    /// Why windows cannot be shown, and what to set; empty where they can.
    std::string refusal;
};

/// Looks for a window system before the toolkit does: the toolkit ends the process where it finds none.
class DisplayProbe
{
public:
    DisplayProbe();

    /// The platform that the user's settings ask for, else the one whose display answers.
    DisplayChoice choose() const;

    /// True if a platform plugin of that name is there and loads; `refusal` tells why not.
    bool canLoad(QString const& name, std::string& refusal) const;

private:
    DisplayChoice chooseAsked(QString const& asked) const;
    DisplayChoice chooseAnswering() const;
    bool isUsable(QString const& platform, std::string& refusal) const;

    /// Plugin file of each platform, by lower-case name.
    QMap<QString, QString> _plugins;
};

} // namespace Kv
