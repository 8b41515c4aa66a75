#pragma once

#include "recovery.h"

#include <QDialog>
#include <QTreeWidget>

#include <vector>

namespace Velmora
{

/// Asks what is to become of changes that are left. It closes with one of the answers, for those that are selected, or
/// without: then it can be asked again another time.
class RecoveryQuestion final : public QDialog
{
public:
    enum Answer
    {
        Later = QDialog::Rejected,
        Restore = QDialog::Accepted,
        ThrowAway,
    };

    /// All are selected at first.
    RecoveryQuestion(QWidget* parent, std::vector<Recovery::Left> const& left);

    /// The places of those that are selected, in order.
    std::vector<std::size_t> getSelected() const;

private:
    void addRow(Recovery::Left const& left);
    QWidget* makeButtons();
    bool confirmLoss();

    QTreeWidget* _list;
};

} // namespace Velmora
