#include "compositionPane.h"

#include "piGraph.h"

#include <QHeaderView>
#include <QLabel>
#include <QTextDocument>
#include <QVBoxLayout>

#include <utility>

namespace Velmora
{

namespace
{

QLabel* makeTitle(QString const& text)
{
    auto* const title = new QLabel(text);
    QFont font = title->font();
    font.setBold(true);
    title->setFont(font);
    return title;
}

QString describe(CompositionEntry const& entry)
{
    QString text = entry.name;
    if (entry.isModified)
        text += QStringLiteral(" *");
    if (!entry.isEditable)
        text += QObject::tr("  (read-only)");
    return text;
}

/// A text as a cell shows it: Qt takes seconds to draw one that is much longer than the screen is wide.
QString toCell(std::string const& text)
{
    constexpr qsizetype most = 4096;
    QString const whole = QString::fromStdString(text);
    return whole.size() <= most ? whole : whole.left(most) + QChar(0x2026);
}

} // namespace

CompositionPane::CompositionPane(QWidget* parent, std::function<void(int)> onChosen)
    : QWidget(parent), _list(new QListWidget), _nodes(new QTreeWidget), _onChosen(std::move(onChosen))
{
    _list->setObjectName(QStringLiteral("compositions"));
    _list->setAccessibleName(tr("Compositions"));
    _nodes->setObjectName(QStringLiteral("nodes"));
    _nodes->setAccessibleName(tr("Nodes"));
    _nodes->setHeaderLabels({tr("Node"), tr("Type or value")});
    _nodes->setEditTriggers(QAbstractItemView::NoEditTriggers);
    auto* const column = new QVBoxLayout(this);
    constexpr int gap = 6;
    column->setContentsMargins(gap, gap, gap, gap);
    column->setSpacing(gap);
    column->addWidget(makeTitle(tr("Compositions")));
    column->addWidget(_list, 1);
    column->addWidget(makeTitle(tr("Nodes")));
    column->addWidget(_nodes, 2);
    // Later: the list is filled anew then, which is in the middle of the item's event now.
    auto const choose = [this](QListWidgetItem* item)
    {
        int const place = _list->row(item);
        QMetaObject::invokeMethod(
            this, [this, place] { _onChosen(place); }, Qt::QueuedConnection);
    };
    connect(_list, &QListWidget::itemActivated, this, choose);
    connect(_list, &QListWidget::itemClicked, this, choose);
}

void CompositionPane::showCompositions(std::vector<CompositionEntry> const& entries)
{
    _list->clear();
    for (CompositionEntry const& entry : entries)
    {
        auto* const item = new QListWidgetItem(describe(entry), _list);
        item->setToolTip(Qt::convertFromPlainText(entry.path, Qt::WhiteSpaceNormal));
        QFont font = item->font();
        font.setBold(entry.isCurrent);
        item->setFont(font);
        if (entry.isCurrent)
            _list->setCurrentItem(item);
    }
}

void CompositionPane::showNodes(Kv::RCShdPtr<const Kv::PiGraph> const& graph)
{
    _nodes->clear();
    if (!graph)
        return;
    for (auto const& node : graph->getNodes())
    {
        auto* const item = new QTreeWidgetItem(_nodes, {toCell(node->getName()), toCell(node->getType())});
        for (auto const& [name, other] : node->getInputs())
            new QTreeWidgetItem(item, {toCell(name), toCell(other)});
        for (auto const& [name, text] : node->getValues())
            new QTreeWidgetItem(item, {toCell(name), toCell(text)});
        item->setExpanded(true);
    }
    _nodes->resizeColumnToContents(0);
}

} // namespace Velmora
