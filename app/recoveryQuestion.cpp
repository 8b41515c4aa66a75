#include "recoveryQuestion.h"

#include "files/osFile.h"

#include <QDateTime>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QLocale>
#include <QMessageBox>
#include <QPushButton>
#include <QVBoxLayout>

namespace Velmora
{

namespace
{

QString toText(std::string const& bytes)
{
    return QString::fromUtf8(bytes.data(), static_cast<qsizetype>(bytes.size()));
}

/// How the composition's file is now, beside what it was when the changes were made.
QString describeFile(Kv::FwComposition const& composition)
{
    if (composition.isChangedOnDisk())
        return QObject::tr("changed since then");
    return Kv::OsFsUtils::fileExists(composition.getPath()) ? QObject::tr("as it was") : QObject::tr("not there");
}

} // namespace

RecoveryQuestion::RecoveryQuestion(QWidget* parent, std::vector<Recovery::Left> const& left)
    : QDialog(parent), _list(new QTreeWidget)
{
    setWindowTitle(tr("Recover Changes"));
    auto* const text = new QLabel(tr("Velmora ended before these changes were saved. What is restored opens with its "
                                     "changes, which are still to be saved. “Later” asks again at the next start."));
    text->setWordWrap(true);
    _list->setObjectName(QStringLiteral("left"));
    _list->setAccessibleName(tr("Changes"));
    _list->setHeaderLabels({tr("Composition"), tr("Folder"), tr("Last change"), tr("Its file is")});
    _list->setRootIsDecorated(false);
    _list->setUniformRowHeights(true);
    _list->setTextElideMode(Qt::ElideMiddle);
    _list->setSelectionMode(QAbstractItemView::ExtendedSelection);
    for (Recovery::Left const& one : left)
        addRow(one);
    QHeaderView& header = *_list->header();
    header.setStretchLastSection(false);
    header.setSectionResizeMode(QHeaderView::ResizeToContents);
    header.setSectionResizeMode(1, QHeaderView::Stretch);
    _list->selectAll();
    auto* const column = new QVBoxLayout(this);
    column->addWidget(text);
    column->addWidget(_list);
    column->addWidget(makeButtons());
    constexpr QSize size(720, 260);
    resize(size);
}

std::vector<std::size_t> RecoveryQuestion::getSelected() const
{
    std::vector<std::size_t> places;
    for (int row = 0; row < _list->topLevelItemCount(); ++row)
        if (_list->topLevelItem(row)->isSelected())
            places.push_back(static_cast<std::size_t>(row));
    return places;
}

void RecoveryQuestion::addRow(Recovery::Left const& left)
{
    Kv::FwComposition const& composition = **left.composition;
    QDateTime const time = QDateTime::fromSecsSinceEpoch(left.time);
    auto* const row = new QTreeWidgetItem(
        _list, {toText(composition.getGraph()->getName()), toText(composition.getPath().getFolder().toString()),
                QLocale().toString(time, QLocale::ShortFormat), describeFile(composition)});
    row->setToolTip(1, toText(composition.getPath().toString()));
}

QWidget* RecoveryQuestion::makeButtons()
{
    auto* const buttons = new QDialogButtonBox;
    auto* const restore = buttons->addButton(tr("&Restore"), QDialogButtonBox::AcceptRole);
    auto* const throwAway = buttons->addButton(tr("&Throw Away"), QDialogButtonBox::DestructiveRole);
    buttons->addButton(tr("&Later"), QDialogButtonBox::RejectRole);
    restore->setDefault(true);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(throwAway, &QPushButton::clicked, this,
            [this]
            {
                if (confirmLoss())
                    done(ThrowAway);
            });
    connect(_list, &QTreeWidget::itemSelectionChanged, this,
            [this, restore, throwAway]
            {
                bool const isAny = !_list->selectedItems().isEmpty();
                restore->setEnabled(isAny);
                throwAway->setEnabled(isAny);
            });
    return buttons;
}

bool RecoveryQuestion::confirmLoss()
{
    QMessageBox box(QMessageBox::Warning, tr("Throw Away Changes"),
                    tr("Throw away the selected changes? They are lost then."), QMessageBox::Cancel, this);
    box.setTextFormat(Qt::PlainText);
    box.addButton(tr("&Throw Away"), QMessageBox::DestructiveRole);
    box.setDefaultButton(QMessageBox::Cancel);
    box.exec();
    activateWindow();
    return box.buttonRole(box.clickedButton()) == QMessageBox::DestructiveRole;
}

} // namespace Velmora
