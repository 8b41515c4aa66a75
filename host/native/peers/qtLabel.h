#pragma once

#include "peers/qtLongText.h"

#include <QLabel>

namespace Kv
{

/// A label on the screen: a text as it is, without markup or shortcuts. Of a text that it has no room for it shows the
/// first lines, and the whole in a tooltip. The mouse can select in it and copy.
class QtLabel final : public QLabel
{
public:
    explicit QtLabel(QWidget* parent);

    /// The words that it shows; of too many not all.
    QString const& getWords() const { return _shown; }
    void setWords(QString const& words);

    /// Makes it the title of what it stands in, which is dragged by it and called by it.
    void makeTitle();

    /// Says which widget the label names, for those who do not see it stand beside it; null for none.
    void setNamed(QWidget* widget);

protected:
    bool event(QEvent* event) override;
    void enterEvent(QEnterEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;
    void paintEvent(QPaintEvent* event) override;

private:
    void showWords();
    QRect getRoom() const;
    TextLines getLines() const;
    void nameSoon() const;

    QString _words;
    QString _shown;
    bool _isTitle = false;
};

} // namespace Kv
