#pragma once

#include "scriptOutput.h"

#include <QElapsedTimer>
#include <QLabel>
#include <QLineEdit>
#include <QTextDocument>
#include <QWidget>

#include <vector>

class QAbstractButton;

namespace Velmora
{

class LogView;

/// The output of scripts and the words about them, each line with the time at which it came. It follows the end, unless
/// the user looks at something above it. What scripts print is seen too while they keep the window's thread busy.
class LogPane final : public QWidget
{
public:
    /// `output` is borrowed, and tells this pane from now on.
    LogPane(QWidget* parent, ScriptOutput& output);
    ~LogPane() override;

    /// Says something of a script.
    void note(QString const& text);

    /// Gives the keyboard to the text, or to the field for what is to be found.
    void goToText();
    void goToSearch();

    /// While it is not usable it can only be scrolled.
    void setUsable(bool usable);

private:
    void layOut();
    QAbstractButton* makeButton(QString const& text, QString const& tip, void (LogPane::*run)());
    void onPrinted();
    /// True if output can be shown before the loop comes around.
    bool hasCredit();
    void showNew();
    void copy();
    void clear();
    void search(QTextDocument::FindFlags direction);

    ScriptOutput& _output;
    LogView* _view;
    QLineEdit* _wanted;
    QLabel* _found;
    std::vector<QWidget*> _tools;
    qint64 _credit = 0;
    QElapsedTimer _sinceCredit;
};

} // namespace Velmora
