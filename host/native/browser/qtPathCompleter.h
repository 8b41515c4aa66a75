#pragma once

#include "browser/qtDirWorker.h"

#include <QCompleter>
#include <QStringList>
#include <QStringListModel>

#include <functional>
#include <string>

namespace Kv
{

/// Proposes the entries of a directory that begin as the last part of a path that is being typed. A worker reads the
/// directory; the proposals come when it is done.
class QtPathCompleter final : public QCompleter
{
public:
    /// `onReady` is called when proposals that had to be waited for are there.
    QtPathCompleter(QObject* parent, std::function<void()> onReady);

    /// The proposals from now on. `path` is what the part of `text` up to its last slash stands for; it need not be
    /// that of a directory.
    void propose(QString const& text, std::string const& path);

    QString pathFromIndex(QModelIndex const& index) const override;

private:
    void filter();

    std::function<void()> _onReady;
    std::string _path;
    /// Of the directory at the path, sorted; a directory has a slash behind its name.
    QStringList _names;
    QString _typedDirectory;
    QString _typedName;
    QStringListModel _model;
    QtDirWorker _worker;
};

} // namespace Kv
