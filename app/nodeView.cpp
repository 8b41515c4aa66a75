#include "nodeView.h"

#include "piGraph.h"

#include <QPainter>
#include <QPainterPath>

#include <algorithm>
#include <map>
#include <string>

namespace Velmora
{

namespace
{

// In pixels, before the picture is made to fit.
constexpr double boxWidth = 128;
constexpr double boxHeight = 46;
constexpr double columnGap = 56;
constexpr double rowGap = 22;
constexpr double margin = 40;

/// Texts that are drawn smaller than this cannot be read.
constexpr double leastTextScale = 0.1;

/// What can be seen of a text in a box: never more characters than pixels.
QString toSeen(std::string const& text)
{
    return QString::fromStdString(text).left(static_cast<int>(boxWidth));
}

using Inputs = std::vector<std::vector<std::size_t>>;

/// The number of steps from each node to one without inputs. Each is visited once, after its inputs; of a ring of nodes
/// the step that closes it counts for nothing.
std::vector<std::size_t> findDepths(Inputs const& inputs)
{
    struct Visit
    {
        std::size_t node;
        std::size_t nextInput = 0;
    };
    std::vector<std::size_t> depths(inputs.size(), 0);
    std::vector<bool> seen(inputs.size(), false);
    std::vector<bool> finished(inputs.size(), false);
    // A stack of its own: a chain can be longer than the program's.
    std::vector<Visit> visits;
    auto const visit = [&](std::size_t node)
    {
        if (!seen[node])
            visits.push_back({node});
        seen[node] = true;
    };
    for (std::size_t start = 0; start < inputs.size(); ++start)
    {
        visit(start);
        while (!visits.empty())
        {
            auto& [node, nextInput] = visits.back();
            if (nextInput < inputs[node].size())
            {
                visit(inputs[node][nextInput++]);
                continue;
            }
            for (std::size_t const input : inputs[node])
                if (finished[input])
                    depths[node] = std::max(depths[node], depths[input] + 1);
            finished[node] = true;
            visits.pop_back();
        }
    }
    return depths;
}

} // namespace

NodeView::NodeView(QWidget* parent) : QWidget(parent)
{
    setAutoFillBackground(true);
    setBackgroundRole(QPalette::Base);
}

void NodeView::show(Kv::RCShdPtr<const Kv::PiGraph> const& graph)
{
    _boxes.clear();
    _extent = QSizeF();
    _hasGraph = !graph.isNull();
    update();
    if (!_hasGraph)
        return;
    std::map<std::string, std::size_t> places;
    std::vector<Kv::RCShdPtr<const Kv::PiNode>> const nodes = graph->getNodes();
    for (auto const& node : nodes)
        places.emplace(node->getName(), places.size());
    Inputs inputs(nodes.size());
    for (std::size_t i = 0; i < nodes.size(); ++i)
        for (auto const& [input, name] : nodes[i]->getInputs())
            if (auto const found = places.find(name); found != places.end())
                inputs[i].push_back(found->second);
    std::vector<std::size_t> const depths = findDepths(inputs);
    std::map<std::size_t, std::size_t> rows;
    for (std::size_t i = 0; i < nodes.size(); ++i)
    {
        auto const column = static_cast<double>(depths[i]);
        auto const row = static_cast<double>(rows[depths[i]]++);
        QRectF const place(column * (boxWidth + columnGap), row * (boxHeight + rowGap), boxWidth, boxHeight);
        _boxes.push_back({toSeen(nodes[i]->getName()), toSeen(nodes[i]->getType()), place, inputs[i]});
        _extent = _extent.expandedTo(QSizeF(place.right(), place.bottom()));
    }
}

void NodeView::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    if (_boxes.empty())
    {
        paintHint(painter);
        return;
    }
    if (!isEnabled())
        painter.setOpacity(0.5);
    double const scale = std::min({1.0, (width() - margin) / _extent.width(), (height() - margin) / _extent.height()});
    painter.translate(width() / 2.0, height() / 2.0);
    painter.scale(scale, scale);
    painter.translate(-_extent.width() / 2, -_extent.height() / 2);
    for (Box const& box : _boxes)
        paintLinks(painter, box);
    for (Box const& box : _boxes)
        paintBox(painter, box);
}

void NodeView::paintHint(QPainter& painter) const
{
    painter.setPen(palette().color(isEnabled() ? QPalette::Active : QPalette::Disabled, QPalette::PlaceholderText));
    QString const hint =
        _hasGraph ? tr("The composition has no nodes") : tr("No composition is open\nCtrl+O opens one");
    painter.drawText(rect(), Qt::AlignCenter, hint);
}

void NodeView::paintLinks(QPainter& painter, Box const& box) const
{
    painter.setPen(QPen(palette().color(QPalette::PlaceholderText), 2));
    painter.setBrush(Qt::NoBrush);
    for (std::size_t const input : box.inputs)
    {
        QRectF const& other = _boxes[input].place;
        QPointF const from(other.right(), other.center().y());
        QPointF const to(box.place.left(), box.place.center().y());
        QPointF const bend(columnGap / 2, 0);
        QPainterPath path(from);
        path.cubicTo(from + bend, to - bend, to);
        painter.drawPath(path);
    }
}

void NodeView::paintBox(QPainter& painter, Box const& box) const
{
    constexpr double corner = 5;
    painter.setPen(QPen(palette().color(QPalette::Highlight), 1.2));
    painter.setBrush(palette().color(QPalette::Button));
    painter.drawRoundedRect(box.place, corner, corner);
    if (painter.transform().m11() < leastTextScale)
        return;
    QRectF const text = box.place.adjusted(8, 5, -8, -5);
    QFont bold = font();
    bold.setBold(true);
    painter.setFont(bold);
    painter.setPen(palette().color(QPalette::ButtonText));
    painter.drawText(text, Qt::AlignTop | Qt::AlignHCenter,
                     QFontMetrics(bold).elidedText(box.name, Qt::ElideRight, static_cast<int>(text.width())));
    painter.setFont(font());
    painter.setPen(palette().color(QPalette::Link));
    painter.drawText(text, Qt::AlignBottom | Qt::AlignHCenter,
                     fontMetrics().elidedText(box.type, Qt::ElideRight, static_cast<int>(text.width())));
}

} // namespace Velmora
