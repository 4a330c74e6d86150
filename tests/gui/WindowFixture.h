#pragma once

#include "app/PLWindow.h"
#include "platform/ListView.h"
#include "platform/qt/WindowWidget.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QApplication>
#include <QComboBox>
#include <QLineEdit>
#include <QTest>
#include <functional>
#include <gmock/gmock.h>
#include <memory>
#include <string>
#include <vector>

class QTemporaryDir;

/// The tabs of the window.
enum Page { kCompanyPage, kCurrencyPage, kPortoFolioPage, kOperationPage, kParameterPage };

/// A test of the real window, on a data folder of its own, on 21/11/2024. What a person does is done by events: clicks
/// and keys.
class WindowTest : public testing::Test {
protected:
    WindowTest();
    ~WindowTest() override;

    /// Closes the window, and opens another one on the same folder.
    void restart();
    /// The page in front.
    BView& pageView();
    QWidget& page();
    PLWindow& window() { return *window_; }
    Wallet& wallet() { return *window_->getWallet(); }
    const std::string& folder() const { return folder_; }
    std::string marketFile() const { return folder_ + "/Companies/Sample"; }
    std::string walletFile() const { return folder_ + "/PortoFolios/Sample"; }
    /// Writes the sample of `pelorin-sample` into the data folder.
    void makeSample() const;

    /// The bytes of both files, were they saved on 21/11/2024.
    std::string bytes();

    /// Clicks on a tab.
    void show(Page page);
    /// The control of that name on the page that is shown; the test fails when there is none.
    template <class Widget>
    Widget& find(const char* name)
    {
        auto* widget = page().findChild<Widget*>(QString::fromUtf8(name));
        if (widget == nullptr)
            throw std::runtime_error(std::string("no such control: ") + name);
        return *widget;
    }
    bool isVisible(const char* name) { return find<QWidget>(name).isVisible(); }
    /// The same on any page or beside the pages.
    QWidget& anywhere(const char* name) { return *window().widget().findChild<QWidget*>(name); }
    BListView& list(const char* name);

    /// Clicks on a button or a check box.
    void click(const char* name);
    /// The same anywhere.
    void press(const char* name);
    /// Presses a key where the keyboard is; `focus` tells where.
    void key(Qt::Key key, Qt::KeyboardModifiers modifiers = {});
    void ctrl(Qt::Key key, Qt::KeyboardModifiers more = {}) { this->key(key, Qt::ControlModifier | more); }
    std::string focus() { return keyboard().objectName().toStdString(); }
    /// Types into a field in place of what is there, without Enter.
    void type(const char* name, const std::string& text);
    /// The same, with Enter.
    void enter(const char* name, const std::string& text);
    std::string text(const char* name);
    /// Names of fields and menus, with what is typed into them or chosen.
    using Fields = std::vector<std::pair<const char*, const char*>>;
    void fill(const Fields& fields);
    /// A click on a button, with what is filled in before it and what the status line says then.
    struct Step {
        Fields fields;
        const char* button;
        const char* message;
    };
    void follow(const std::vector<Step>& steps);
    /// Chooses the item of a menu by keys.
    void choose(const char* name, const std::string& item);
    /// Clicks on a row; with `more` the ones selected before stay so.
    void select(const char* list, int row, bool more = false);
    /// The texts of a list's rows, cells with tabs between.
    std::vector<std::string> rows(const char* list);

    /// What the status line shows.
    std::string message() const;
    /// What the page says of its file.
    std::string openFile() { return find<QWidget>("txtOpenFile").accessibleName().toStdString(); }
    /// Takes away what an empty window offers.
    void dismissOffer() { window().dropNotice("first steps"); }
    void clearMessage() { window().SetMessage(""); }
    /// The notice that is shown; empty when there is none.
    std::string notice();
    /// Sends a code as a control does.
    void post(uint32 code);
    /// Handles all that waits.
    static void settle();

    /// The button of the next alert that a person clicks, or "Enter" or "Escape" for the key; the alert's text is
    /// noted. Without it an alert fails the test.
    void answerNextAlert(const char* button) { alertAnswer_ = button; }
    /// The texts of the alerts since the last call.
    std::vector<std::string> alerts() { return std::exchange(alerts_, {}); }
    /// Chooses a file in the panel that is open, by keys; an empty path leaves the panel by Escape.
    void answerPanel(const char* panel, const std::string& path);
    /// The folder that a panel shows; empty while it is not open.
    std::string panelFolder(const char* panel) const;

    /// A file by button and panel; what would be lost is let go.
    void loadMarkets(const std::string& path) { load(kCompanyPage, "btnLoadMarket", path); }
    void loadWallet(const std::string& path) { load(kPortoFolioPage, "btnLoadPortoFolio", path); }
    /// Makes both files of the sample, and loads them.
    void loadSample();

    /// What `restart` makes: another kind of window.
    void setMaker(const std::function<PLWindow*(BRect, const DataFolder&)>& make) { make_ = make; }

private:
    void open();
    void load(Page page, const char* button, const std::string& path);
    void activate();
    /// What has the keyboard, or gets it back when the window does.
    QWidget& keyboard();
    void watchForAlert();

    std::unique_ptr<QTemporaryDir> temporary_;
    std::string folder_;
    std::function<PLWindow*(BRect, const DataFolder&)> make_ = [](BRect frame, const DataFolder& folder) {
        return new PLWindow(frame, folder);
    };
    PLWindow* window_; // owns itself
    std::string alertAnswer_;
    std::vector<std::string> alerts_;
    std::unique_ptr<QObject> watcher_;
};
