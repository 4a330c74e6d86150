#include "platform/Alert.h"

#include "platform/DialogAnswers.h"
#include "platform/Labels.h"

#include <QApplication>
#include <QMessageBox>
#include <QPushButton>

BAlert::BAlert(const char* title, const char* text, const char* button0, const char* button1, const char* button2)
    : title_(title), text_(text)
{
    for (const char* button : {button0, button1, button2}) {
        if (button != nullptr)
            buttons_.emplace_back(button);
    }
}

int32 BAlert::Go()
{
    const auto& answer = DialogAnswers::current().alert;
    const int32 chosen = answer ? answer(title_.c_str(), text_.c_str()) : ask();
    delete this;
    return chosen;
}

int32 BAlert::ask() const
{
    QMessageBox box(QMessageBox::Warning, QString::fromStdString(title_), QString::fromStdString(text_),
                    QMessageBox::NoButton, QApplication::activeWindow());
    box.setObjectName("Alert");
    box.setTextFormat(Qt::PlainText);
    // The desktop's own order of roles would move buttons about; these stay as they were given.
    for (const auto& label : buttons_) {
        QPushButton* button = box.addButton(labelText(label.c_str()), QMessageBox::ResetRole);
        box.setDefaultButton(button);
        if (&label == &buttons_.front())
            box.setEscapeButton(button);
    }
    box.exec();
    const auto buttons = box.buttons();
    for (int i = 0; i < buttons.size(); ++i) {
        if (buttons[i] == box.clickedButton())
            return i;
    }
    return 0;
}
