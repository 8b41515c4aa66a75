#pragma once

#include <QLineEdit>

#include <functional>
#include <string>

namespace Kv
{

class QtPathCompleter;

/// Shows the path of the current directory and lets the user type another one, with proposals. Enter asks to go there.
class QtPathField final : public QLineEdit
{
public:
    QtPathField(QWidget* parent, std::function<void()> onEnter);

    /// The current directory, in bytes of the file system. What the user has typed is gone.
    void setDirectory(std::string const& directory);

    /// True if the user has typed something else since.
    bool isEdited() const;

    /// The path that the user has typed, in bytes of the file system; it can be relative to the current directory.
    std::string getTypedPath() const;

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    void propose();
    void showProposals();
    std::string toTypedPath(QString const& text) const;

    std::function<void()> _onEnter;
    std::string _directory;
    QString _shown;
    /// Owned by this one natively.
    QtPathCompleter* _completer;
};

} // namespace Kv
