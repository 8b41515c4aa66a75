#pragma once

#include "piGraph.h"

#include <QString>
#include <QWidget>

#include <vector>

namespace Velmora
{

/// Picture of a graph: its nodes as boxes, from what has no input on the left to what nothing else needs on the right.
class NodeView final : public QWidget
{
public:
    explicit NodeView(QWidget* parent);

    /// Shows a graph as it is now; null for none.
    void show(Kv::RCShdPtr<const Kv::PiGraph> const& graph);

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    struct Box
    {
        QString name;
        QString type;
        QRectF place;
        std::vector<std::size_t> inputs;
    };

    void paintHint(QPainter& painter) const;
    void paintLinks(QPainter& painter, Box const& box) const;
    void paintBox(QPainter& painter, Box const& box) const;

    std::vector<Box> _boxes;
    QSizeF _extent;
    bool _hasGraph = false;
};

} // namespace Velmora
