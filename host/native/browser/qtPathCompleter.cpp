#include "browser/qtPathCompleter.h"

#include "exBase.h"
#include "peers/qtText.h"

#include <QAbstractItemView>

#include <algorithm>
#include <utility>

namespace Kv
{

namespace
{

/// More than these nobody reads.
constexpr int maxProposals = 200;

} // namespace

QtPathCompleter::QtPathCompleter(QObject* parent, std::function<void()> onReady)
    : QCompleter(parent), _onReady(std::move(onReady))
{
    setCompletionMode(UnfilteredPopupCompletion);
    setModel(&_model);
    connect(&_timer, &QTimer::timeout, this, [this] { work(); });
}

void QtPathCompleter::propose(QString const& text, std::string const* directory)
{
    auto const nameStart = text.lastIndexOf(QLatin1Char('/')) + 1;
    _typedDirectory = text.left(nameStart);
    _typedName = text.mid(nameStart);
    std::string const wanted = directory && !text.isEmpty() ? *directory : std::string();
    if (wanted != _directory)
    {
        _directory = wanted;
        _names.clear();
        _timer.stop();
        try
        {
            OsDirScan::Options options;
            options.showsHidden = true;
            _scan = wanted.empty() ? nullptr : std::make_unique<OsDirScan>(wanted, options);
            if (_scan)
                _timer.start(0);
        }
        catch (ExBase const&)
        {
            _scan = nullptr;
        }
    }
    filter();
}

QString QtPathCompleter::pathFromIndex(QModelIndex const& index) const
{
    return _typedDirectory + index.data().toString();
}

void QtPathCompleter::work()
{
    try
    {
        if (!_scan->step())
            return;
        for (OsDirEntry const& entry : _scan->getEntries())
        {
            QString const name = toQString(entry.name);
            // A name that cannot be typed leads nowhere.
            if (toPath(name) == entry.name)
                _names.append(entry.isDirectory ? name + QLatin1Char('/') : name);
        }
    }
    catch (ExBase const&)
    {
        _names.clear();
    }
    _timer.stop();
    _scan = nullptr;
    _names.sort();
    filter();
    _onReady();
}

void QtPathCompleter::filter()
{
    QStringList proposals;
    for (auto name = std::lower_bound(_names.cbegin(), _names.cend(), _typedName);
         name != _names.cend() && name->startsWith(_typedName) && proposals.size() < maxProposals; ++name)
        if (!name->startsWith(QLatin1Char('.')) || _typedName.startsWith(QLatin1Char('.')))
            proposals.append(*name);
    // What is typed in full needs no proposal.
    if (proposals.size() == 1 && proposals.front() == _typedName)
        proposals.clear();
    _model.setStringList(proposals);
}

} // namespace Kv
