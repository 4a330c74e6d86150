#include "platform/Alert.h"

#include "platform/DialogAnswers.h"
#include "platform/Window.h"
#include "platform/qt/Labels.h"
#include "platform/qt/WindowWidget.h"

#include <QDialog>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QScreen>
#include <QStyle>
#include <QVBoxLayout>

BAlert::BAlert(const char* title, const char* text, const char* button0, const char* button1, const char* button2)
    : title_(title), text_(text)
{
    for (const char* button : {button0, button1, button2}) {
        if (button != nullptr)
            buttons_.emplace_back(button);
    }
    default_ = buttons_.size() - 1;
}

int32 BAlert::Go()
{
    // Tests and the tour answer by themselves; then no dialog comes up.
    const auto& answer = DialogAnswers::current().alert;
    const int32 chosen = answer ? answer(title_.c_str(), text_.c_str()) : ask();
    delete this;
    return chosen;
}

int32 BAlert::ask() const
{
    constexpr int kMargin = 16;
    // Lives as long as this function, in which the event loop of `exec` runs: windows are painted meanwhile, and
    // messages wait, as the one that asks is still being handled.
    QDialog dialog(BWindow::front());
    dialog.setObjectName("Alert");
    dialog.setWindowTitle(QString::fromStdString(title_));
    auto* rows = new QVBoxLayout(&dialog); // the dialog owns what is laid out in it
    rows->setContentsMargins(kMargin, kMargin, kMargin, kMargin);
    rows->setSpacing(kMargin);

    auto* message = new QHBoxLayout;
    message->setSpacing(kMargin);
    auto* icon = new QLabel;
    icon->setPixmap(dialog.style()->standardIcon(QStyle::SP_MessageBoxWarning).pixmap(2 * kMargin));
    auto* text = new QLabel(QString::fromStdString(text_));
    text->setObjectName("AlertText");
    text->setTextFormat(Qt::PlainText);
    // A long line is broken, so that all of it is on the screen.
    const int most = dialog.screen()->availableGeometry().width() * 3 / 4;
    if (text->sizeHint().width() > most) {
        text->setWordWrap(true);
        text->setFixedWidth(most);
    }
    message->addWidget(icon);
    message->addWidget(text, 1);
    rows->addLayout(message);

    // From left to right as they were given, at the right.
    auto* answers = new QHBoxLayout;
    rows->addLayout(answers); // before the buttons, which then are the dialog's when one of them gets the keyboard
    answers->addStretch(1);
    for (std::size_t i = 0; i < buttons_.size(); ++i) {
        auto* button = new QPushButton(labelText(buttons_[i].c_str()));
        button->setObjectName(QString::fromStdString(buttons_[i]));
        button->setAccessibleName(QString::fromStdString(buttons_[i]));
        // Enter presses the default from the start; once another one has the keyboard, that.
        button->setDefault(i == default_);
        button->setAutoDefault(true);
        QObject::connect(button, &QPushButton::clicked, [&dialog, i] { dialog.done(static_cast<int>(i)); });
        answers->addWidget(button);
        if (i == default_)
            button->setFocus();
    }
    return dialog.exec(); // Escape gives 0, as the first button does
}
