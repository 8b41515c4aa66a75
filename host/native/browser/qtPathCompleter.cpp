#include "browser/qtPathCompleter.h"

#include "browser/qtDirListing.h"
#include "files/osAsync.h"
#include "files/osPlace.h"
#include "peers/qtText.h"

#include <QAbstractItemView>

#include <algorithm>
#include <exception>
#include <utility>

namespace Kv
{

namespace
{

/// More than these nobody reads.
constexpr int maxProposals = 200;

/// The sorted names of a directory's entries as one types them; none where there is no directory, or it cannot be read.
QStringList readNames(std::string const& path, std::atomic<bool> const& cancelled)
{
    QtDirListing::Options options;
    options.showsHidden = true;
    QStringList names;
    try
    {
        OsPlace const place = OsPlace::find(path);
        if (!place.name.empty())
            return {};
        QtDirListing const listing(place.directory, options, cancelled);
        for (QtDirEntry const& entry : listing.getEntries())
        {
            QString const name = toQString(entry.name);
            // A name that cannot be typed leads nowhere.
            if (toPath(name) == entry.name)
                names.append(entry.isDirectory ? name + QLatin1Char('/') : name);
        }
    }
    catch (std::exception const&)
    {
        return {};
    }
    names.sort();
    return names;
}

} // namespace

QtPathCompleter::QtPathCompleter(QObject* parent, std::function<void()> onReady)
    : QCompleter(parent), _onReady(std::move(onReady))
{
    setCompletionMode(UnfilteredPopupCompletion);
    setModel(&_model);
}

void QtPathCompleter::propose(QString const& text, std::string const& path)
{
    auto const nameStart = text.lastIndexOf(QLatin1Char('/')) + 1;
    _typedDirectory = text.left(nameStart);
    _typedName = text.mid(nameStart);
    std::string const wanted = text.isEmpty() ? std::string() : path;
    if (wanted != _path)
    {
        _path = wanted;
        _names.clear();
        _worker.cancel();
        if (!wanted.empty())
            _worker.start(OsAsync::getEntries(wanted),
                          [this, wanted](std::atomic<bool> const& cancelled)
                          {
                              return [this, names = readNames(wanted, cancelled)]
                              {
                                  _names = names;
                                  filter();
                                  _onReady();
                              };
                          });
    }
    filter();
}

QString QtPathCompleter::pathFromIndex(QModelIndex const& index) const
{
    return _typedDirectory + index.data().toString();
}

void QtPathCompleter::filter()
{
    QStringList proposals;
    for (auto name = std::lower_bound(_names.cbegin(), _names.cend(), _typedName);
         name != _names.cend() && name->startsWith(_typedName) && proposals.size() < maxProposals; ++name)
        if (!name->startsWith(QLatin1Char('.')) || _typedName.startsWith(QLatin1Char('.')))
            proposals.append(*name);
    // A name that is typed in full needs no proposal.
    if (proposals.size() == 1 && proposals.front() == _typedName)
        proposals.clear();
    _model.setStringList(proposals);
}

} // namespace Kv
