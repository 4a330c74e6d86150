#include "tests/gui/WindowFixture.h"

#include "app/MessageView.h"
#include "foundation/Today.h"
#include "platform/ListItem.h"
#include "platform/TabView.h"
#include "tests/support/Bytes.h"
#include "tests/support/ToolRun.h"

#include <QDialog>
#include <QFileDialog>
#include <QLabel>
#include <QTabBar>
#include <QTemporaryDir>
#include <QThread>
#include <QTimer>

namespace {

QFileDialog* findPanel(const char* name)
{
    for (QWidget* widget : QApplication::topLevelWidgets()) {
        if (widget->objectName() == name && widget->isVisible())
            return qobject_cast<QFileDialog*>(widget);
    }
    return nullptr;
}

} // namespace

WindowTest::WindowTest() : temporary_(std::make_unique<QTemporaryDir>()), folder_(temporary_->path().toStdString())
{
    setToday(Date(21, 11, 2024));
    open();
    watchForAlert();
}

WindowTest::~WindowTest()
{
    watcher_.reset();
    settle();
    window_->Quit();
    setToday(Date());
}

void WindowTest::restart()
{
    window_->Quit();
    open();
}

void WindowTest::open()
{
    window_ = make_({50, 50, 850, 850}, DataFolder(folder_));
    window_->Show();
    window_->makeOtherPages(); // which a person would wait for without noticing
    activate();
}

/// As a desktop does with a new window, and with the one below a dialog that closes. Without it no field would lose the
/// keyboard.
void WindowTest::activate()
{
    window_->widget().raise();
    window_->widget().activateWindow();
    QApplication::setActiveWindow(&window_->widget());
    ASSERT_TRUE(QTest::qWaitForWindowActive(&window_->widget()));
    settle();
    ASSERT_TRUE(window_->widget().isActiveWindow());
}

void WindowTest::makeSample() const
{
    const ToolRun run(PELORIN_SAMPLE, "'" + folder_ + "'", TemporaryFolder("pelorin-gui"));
    ASSERT_EQ(run.status, 0) << run.err;
}

std::string WindowTest::bytes()
{
    return bytesWritten(window().catalogue(), today()) + "\n--\n" + bytesWritten(wallet(), today());
}

void WindowTest::settle()
{
    constexpr int kRounds = 4; // a message may post further ones
    for (int i = 0; i < kRounds; ++i) {
        QApplication::sendPostedEvents();
        QApplication::processEvents();
    }
}

BView& WindowTest::pageView()
{
    auto* tabs = static_cast<BTabView*>(window_->FindView("TabView"));
    return *tabs->TabAt(tabs->Selection())->View();
}

QWidget& WindowTest::page()
{
    return *pageView().widget();
}

void WindowTest::show(Page page)
{
    auto* bar = window_->widget().findChild<QTabBar*>();
    QTest::mouseClick(bar, Qt::LeftButton, {}, bar->tabRect(page).center());
    settle();
}

BListView& WindowTest::list(const char* name)
{
    auto* found = dynamic_cast<BListView*>(pageView().FindView(name));
    if (found == nullptr)
        throw std::runtime_error(std::string("no such list: ") + name);
    return *found;
}

void WindowTest::click(const char* name)
{
    auto& button = find<QAbstractButton>(name);
    ASSERT_TRUE(button.isVisible()) << name;
    // A check box answers on its box and its label, not behind them.
    constexpr int kInside = 8;
    QTest::mouseClick(&button, Qt::LeftButton, {}, {kInside, button.height() / 2});
    settle();
}

void WindowTest::press(const char* name)
{
    ASSERT_TRUE(anywhere(name).isVisible()) << name;
    QTest::mouseClick(&anywhere(name), Qt::LeftButton);
    settle();
}

void WindowTest::key(Qt::Key key, Qt::KeyboardModifiers modifiers)
{
    QTest::keyClick(&keyboard(), key, modifiers);
    settle();
}

QWidget& WindowTest::keyboard()
{
    QWidget& desktop = window().widget();
    for (QWidget* widget : {QApplication::focusWidget(), desktop.focusWidget()})
        if (widget != nullptr)
            return *widget;
    return desktop;
}

void WindowTest::type(const char* name, const std::string& text)
{
    auto& field = find<QLineEdit>(name);
    ASSERT_TRUE(field.isVisible()) << name;
    QTest::mouseClick(&field, Qt::LeftButton);
    QTest::keyClick(&field, Qt::Key_A, Qt::ControlModifier);
    QTest::keyClick(&field, Qt::Key_Delete);
    QTest::keyClicks(&field, QString::fromStdString(text));
    settle();
}

void WindowTest::enter(const char* name, const std::string& text)
{
    type(name, text);
    QTest::keyClick(&find<QLineEdit>(name), Qt::Key_Return);
    settle();
}

std::string WindowTest::text(const char* name)
{
    return find<QLineEdit>(name).text().toStdString();
}

void WindowTest::fill(const Fields& fields)
{
    for (const auto& [field, entered] : fields) {
        if (std::string_view(field).starts_with("txt"))
            type(field, entered);
        else
            choose(field, entered);
    }
}

void WindowTest::follow(const std::vector<Step>& steps)
{
    for (const Step& step : steps) {
        fill(step.fields);
        clearMessage();
        click(step.button);
        EXPECT_EQ(message(), step.message) << step.button;
    }
}

void WindowTest::choose(const char* name, const std::string& item)
{
    auto& menu = find<QComboBox>(name);
    const int index = menu.findText(QString::fromStdString(item));
    ASSERT_GE(index, 0) << name << " has no " << item;
    menu.setFocus();
    const int steps = index - menu.currentIndex();
    for (int i = 0; i < std::abs(steps); ++i)
        QTest::keyClick(&menu, steps > 0 ? Qt::Key_Down : Qt::Key_Up);
    settle();
}

void WindowTest::select(const char* name, int row, bool more)
{
    BListView& rows = list(name);
    auto* widget = static_cast<QAbstractItemView*>(rows.widget());
    rows.ScrollTo(row);
    settle();
    const QRect place = widget->visualRect(widget->model()->index(row, 0));
    ASSERT_TRUE(place.isValid()) << name << " has no row " << row;
    QTest::mouseClick(widget->viewport(), Qt::LeftButton, more ? Qt::ControlModifier : Qt::NoModifier, place.center());
    settle();
}

std::vector<std::string> WindowTest::rows(const char* name)
{
    const BListView& shown = list(name);
    std::vector<std::string> texts;
    for (int32 i = 0; i < shown.CountItems(); ++i)
        texts.push_back(shown.ItemAt(i)->Text());
    return texts;
}

std::string WindowTest::message() const
{
    const char* text = static_cast<MessageView*>(window_->FindView("MessageView"))->Message();
    return text != nullptr ? text : "";
}

std::string WindowTest::notice()
{
    const QWidget& line = anywhere("txtNotice");
    return line.isVisible() ? line.accessibleName().toStdString() : "";
}

void WindowTest::post(uint32 code)
{
    window_->PostMessage(code);
    settle();
}

/// An alert waits for its answer in a loop of its own; a timer finds it there.
void WindowTest::watchForAlert()
{
    constexpr int kMilliseconds = 2;
    auto timer = std::make_unique<QTimer>();
    QObject::connect(timer.get(), &QTimer::timeout, [this] {
        auto* alert = qobject_cast<QDialog*>(QApplication::activeModalWidget());
        const bool isWaiting = QThread::currentThread()->loopLevel() > 0; // and not just being shown
        if (alert == nullptr || alert->objectName() != "Alert" || !isWaiting || alert->property("isAnswered").toBool())
            return;
        alert->setProperty("isAnswered", true);
        alerts_.push_back(alert->findChild<QLabel*>("AlertText")->text().toStdString());
        EXPECT_EQ(alert->windowTitle().toStdString(), "Warning");
        EXPECT_FALSE(alertAnswer_.empty()) << "nobody expected: " << alerts_.back();
        const std::string answer = std::exchange(alertAnswer_, "");
        if (answer == "Enter" || answer == "Escape")
            QTest::keyClick(alert, answer == "Enter" ? Qt::Key_Return : Qt::Key_Escape);
        for (auto* button : alert->findChildren<QAbstractButton*>()) {
            if (button->text().toStdString() == answer || (answer.empty() && button->text() == "Cancel"))
                QTest::mouseClick(button, Qt::LeftButton);
        }
    });
    timer->start(kMilliseconds);
    watcher_ = std::move(timer);
}

std::string WindowTest::panelFolder(const char* panel) const
{
    const QFileDialog* shown = findPanel(panel);
    return shown != nullptr ? shown->directory().absolutePath().toStdString() : "";
}

void WindowTest::answerPanel(const char* panel, const std::string& path)
{
    QFileDialog* shown = findPanel(panel);
    ASSERT_NE(shown, nullptr) << panel << " is not open";
    auto* field = shown->findChild<QLineEdit*>("fileNameEdit");
    if (path.empty()) {
        QTest::keyClick(shown, Qt::Key_Escape);
    } else {
        field->selectAll();
        QTest::keyClicks(field, QString::fromStdString(path));
        QTest::keyClick(field, Qt::Key_Return);
    }
    settle();
    EXPECT_EQ(findPanel(panel), nullptr);
    activate();
}

void WindowTest::load(Page page, const char* button, const std::string& path)
{
    show(page);
    if (page == kPortoFolioPage || window().catalogue().getNbrCurrencies() > 0)
        answerNextAlert("Continue");
    click(button);
    answerPanel("OpenPanel", path);
}

void WindowTest::loadSample()
{
    makeSample();
    loadMarkets(marketFile());
    ASSERT_EQ(message(), "Markets successfully loaded...");
    loadWallet(walletFile());
    ASSERT_EQ(message(), "Wallet successfully loaded...");
    alerts();
}
