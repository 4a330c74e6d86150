#include "platform/Roster.h"

#include "platform/DialogAnswers.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/Messenger.h"

#include <QDesktopServices>
#include <QElapsedTimer>
#include <QProcess>
#include <QStandardPaths>
#include <QUrl>

#include <unistd.h>

#include <functional>
#include <memory>

namespace {

const BRoster roster;

/// Runs a program that tells by its exit status whether it has opened the file.
void run(const QString& program, const QString& file, const std::function<void()>& fail)
{
    constexpr qint64 kStarting = 30000; // what ends later was there, and a person has seen it
    QElapsedTimer timer;
    timer.start();
    // Lives as long as the program, which it would take along. One that runs longer than this process is left alone.
    auto* process = new QProcess;
    process->setStandardInputFile(QProcess::nullDevice());
    process->setStandardOutputFile(QProcess::nullDevice());
    process->setStandardErrorFile(QProcess::nullDevice());
    // Ctrl+C in the terminal that this program was started from is not meant for it.
    process->setChildProcessModifier([] { ::setsid(); });
    QObject::connect(process, &QProcess::finished, [=](int status, QProcess::ExitStatus end) {
        if ((status != 0 || end != QProcess::NormalExit) && timer.elapsed() < kStarting)
            fail();
        process->deleteLater();
    });
    QObject::connect(process, &QProcess::errorOccurred, [=](QProcess::ProcessError error) {
        if (error != QProcess::FailedToStart)
            return; // it ends behind this
        fail();
        process->deleteLater();
    });
    process->start(program, {file});
}

} // namespace

const BRoster* const be_roster = &roster;

void BRoster::Launch(const entry_ref* file, const BMessenger& target, BMessage* failed) const
{
    const std::shared_ptr<const BMessage> message(failed);
    const auto fail = [target, message] { target.SendMessage(message.get()); };
    BPath place;
    BEntry(file).GetPath(&place);
    const QString path = QString::fromUtf8(place.Path());
    if (const auto& answer = DialogAnswers::current().launch) {
        if (!answer(place.Path()))
            fail();
        return;
    }
    // Qt would start the same program, but not look at what becomes of it.
    if (const QString opener = QStandardPaths::findExecutable("xdg-open"); !opener.isEmpty())
        run(opener, path, fail);
    else if (!QDesktopServices::openUrl(QUrl::fromLocalFile(path)))
        fail();
}
