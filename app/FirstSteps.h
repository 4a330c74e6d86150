#pragma once

#include "platform/SupportDefs.h"
#include "storage/DataFolder.h"

#include <string>

class BTabView;
class DataFiles;
class PLWindow;

/// What a window without any data offers, in a notice behind all others: the files that were saved last, the
/// sample, and the guide. Nothing is loaded by itself.
class FirstSteps {
public:
    static constexpr uint32 kOpenLast = 'FsLa';
    static constexpr uint32 kOpenSample = 'FsSa';

    /// All of them outlive this.
    FirstSteps(PLWindow& window, BTabView& tabs, DataFiles& files, const DataFolder& folder);

    /// Shows the notice when the window has come to be empty, and takes it away when it is not any more; to be called
    /// after every command. While it stays empty, a notice that was dismissed does not come back.
    void update();
    /// Loads the market file and the portfolio of the data folder that were saved last.
    void openLast();
    /// Loads the sample, which is written into the data folder when it is not there.
    void openSample();

private:
    struct Files {
        std::string markets; // a path; empty when there is none
        std::string wallet;
    };

    /// By their times on disk.
    Files lastFiles() const;
    bool isWindowEmpty() const;
    void open(const Files& files);

    PLWindow& window_;
    BTabView& tabs_;
    DataFiles& files_;
    DataFolder folder_;
    bool wasEmpty_ = false;
};
