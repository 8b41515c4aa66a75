#pragma once

#include "piGraph.h"

#include <QListWidget>
#include <QTreeWidget>
#include <QWidget>

#include <functional>
#include <vector>

namespace Velmora
{

/// A composition as the pane shows it.
struct CompositionEntry
{
    QString name;
    QString path;
    bool isCurrent = false;
    bool isEditable = false;
    bool isModified = false;
};

/// The open compositions, of which Enter or a click makes one the current one, and the nodes of that.
class CompositionPane final : public QWidget
{
public:
    /// `onChosen` gets the place of the composition in the list.
    CompositionPane(QWidget* parent, std::function<void(int)> onChosen);

    void showCompositions(std::vector<CompositionEntry> const& entries);

    /// They give the keyboard to one of the two.
    void goToList() { _list->setFocus(Qt::ShortcutFocusReason); }
    void goToNodes() { _nodes->setFocus(Qt::ShortcutFocusReason); }

    /// Null for no graph.
    void showNodes(Kv::RCShdPtr<const Kv::PiGraph> const& graph);

private:
    QListWidget* _list;
    QTreeWidget* _nodes;
    std::function<void(int)> _onChosen;
};

} // namespace Velmora
