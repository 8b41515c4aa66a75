#include "stopWindow.h"

#include "theme.h"

#include "wsNative.h"

#include <QApplication>
#include <QDialog>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QSocketNotifier>
#include <QTimer>
#include <QVBoxLayout>
#include <QWindow>

#include <string_view>
#include <unistd.h>

namespace Velmora::StopWindow
{

namespace
{

constexpr char const* option = "--stop-window";

/// The option and what comes behind it.
constexpr int argumentCount = 6;

/// The time that a script may take to stop before it can be asked again, in milliseconds.
constexpr int stopTime = 3000;

/// Asks the application to stop the script.
void ask(QPushButton& button)
{
    if (write(STDIN_FILENO, "s", 1) != 1)
        QApplication::quit();
    button.setText(QObject::tr("Stopping…"));
    button.setEnabled(false);
    QTimer::singleShot(stopTime, &button,
                       [&button]
                       {
                           button.setText(QObject::tr("Stop Script"));
                           button.setEnabled(true);
                       });
}

void fill(QDialog& window, QString const& script)
{
    auto* const text = new QLabel(QObject::tr("%1 is busy, and the window of Velmora does not answer.").arg(script));
    text->setTextFormat(Qt::PlainText);
    auto* const stop = new QPushButton(QObject::tr("Stop Script"));
    auto* const wait = new QPushButton(QObject::tr("Wait"));
    QObject::connect(stop, &QPushButton::clicked, stop, [stop] { ask(*stop); });
    QObject::connect(wait, &QPushButton::clicked, &window, &QDialog::reject);
    wait->setDefault(true);
    auto* const buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(wait);
    buttons->addWidget(stop);
    auto* const column = new QVBoxLayout(&window);
    constexpr int margin = 16;
    column->setContentsMargins(margin, margin, margin, margin);
    column->setSpacing(margin);
    column->addWidget(text);
    column->addLayout(buttons);
}

} // namespace

std::vector<std::string> makeCommand(BusyWatch::Offer const& offer)
{
    return {"velmora",
            option,
            offer.script,
            std::to_string(offer.middle.x()),
            std::to_string(offer.middle.y()),
            std::to_string(offer.window)};
}

bool isWanted(int argc, char** argv)
{
    return argc == argumentCount && std::string_view(argv[1]) == option;
}

int run(char** argv)
{
    Kv::WsNative::getPlatform();
    // Where its display is gone, nobody would see it.
    if (QGuiApplication::platformName() == QLatin1String("offscreen"))
        return 1;
    applyTheme();
    QDialog window;
    window.setWindowTitle(QObject::tr("Script Is Busy"));
    fill(window, QString::fromUtf8(argv[2]));
    QSize const size = window.sizeHint();
    window.setGeometry(
        QRect(QPoint(std::stoi(argv[3]), std::stoi(argv[4])) - QPoint(size.width(), size.height()) / 2, size));
    // Keys that are typed for another window must not stop anything.
    window.setAttribute(Qt::WA_ShowWithoutActivating);
    window.winId();
    if (WId const owner = std::stoull(argv[5]))
        window.windowHandle()->setTransientParent(QWindow::fromWinId(owner));
    window.show();
    QObject::connect(&window, &QDialog::finished, &window, [] { QApplication::quit(); });
    QSocketNotifier gone(STDIN_FILENO, QSocketNotifier::Read);
    QObject::connect(&gone, &QSocketNotifier::activated, &window, [] { QApplication::quit(); });
    return QApplication::exec();
}

} // namespace Velmora::StopWindow
