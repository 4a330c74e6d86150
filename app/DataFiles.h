#pragma once

#include "app/FileKind.h"
#include "foundation/String.h"
#include "platform/FilePanel.h"
#include "storage/DataFolder.h"
#include "storage/FileStamp.h"

#include <array>
#include <cstdio>
#include <optional>
#include <string>

class BMessage;
class BPath;
class BTabView;
class InputFile;
class PLWindow;

/// The commands on files: asking for one in a panel, loading and saving it. The tab that is in front decides which kind
/// of file a command is about.
///
/// Of each kind the file loaded or saved last is remembered, and saved to without asking. Only where that would write
/// over something by mistake is the name asked for once more, and a notice says why: the load of that file has failed;
/// the portfolio is empty because a market file was loaded since, and the file's is not; another program or window has
/// changed the file since.
class DataFiles {
public:
    struct Remembered {
        String path = {};                    ///< undefined before the first file
        std::optional<FileStamp> stamp = {}; ///< of the file as it was loaded or saved; nothing when that is not known
        std::string failure = {};            ///< why it could not be loaded; empty when it could
        bool isEmptied = false;              ///< the portfolio was thrown away by a market file

        /// The next save asks for a name, whatever the file has.
        bool isAsked() const { return !failure.empty(); }

        /// The same file, in the same trouble.
        bool operator==(const Remembered& other) const
        {
            return path.bytes() == other.path.bytes() && failure == other.failure && isEmptied == other.isEmptied;
        }
    };
    /// The file of each kind that was loaded or saved last.
    struct Names {
        Remembered markets;
        Remembered wallet;

        Remembered& of(FileKind kind) { return kind == FileKind::kMarkets ? markets : wallet; }
        const Remembered& of(FileKind kind) const { return kind == FileKind::kMarkets ? markets : wallet; }
        bool operator==(const Names&) const = default;
    };
    /// What is to be read of a kind of file in place of what is here.
    struct Restored {
        std::string source; ///< the file to be read; empty when there was none
        Remembered name;    ///< of the file that is saved to from then on
        bool isCopy;        ///< of what was not saved: `source` is not that file
    };
    struct Restoring {
        bool isComplete;     ///< all copies were read
        std::string problem; ///< what could not be read, as one line for the user; empty when all was
    };

    /// The panels open in `folder`, and it keeps the files that are replaced. Window and tabs outlive this.
    DataFiles(PLWindow& window, const BTabView& tabs, const DataFolder& folder);

    /// Asks whether what is here may go, and shows the open panel; while the window closes, without a question.
    void askForLoad();
    /// The answer of the open panel: loads the file. When it can be opened the portfolio goes, whichever kind it is.
    void load(BMessage* message);
    /// The same with a market file and a portfolio that fits it, in place of all that is here. Nothing happens, after a
    /// message, when either cannot be opened. An empty path stands for no portfolio.
    void loadBoth(const std::string& markets, const std::string& wallet);
    /// Asks whether what is here may go, where there is something.
    bool mayReplaceAll() const;
    /// Reads both in place of all that is here. When a copy, or the market data, cannot be opened, nothing changes.
    Restoring restore(const Restored& markets, const Restored& wallet);
    /// Saves to the file that is remembered, or shows the save panel, with the file's name in it when there is one.
    void saveOrAsk();
    /// The answer of the save panel. @return `B_OK`; what is missing in the message.
    status_t save(BMessage* message);
    void save(const String& path);
    /// What a save panel was left with. `*path` is set with `B_OK`; otherwise something is missing in the message.
    static status_t chosenPath(const BMessage& message, BPath* path);
    /// The next save of the portfolio asks for a name.
    void forgetWallet();

    bool isWalletEmpty() const;
    /// Whether `path` is one of the files that are remembered.
    bool isOpen(const std::string& path) const;
    const Names& names() const { return names_; }
    /// For an undo of a load: from here on these are the files that are saved to.
    void setNames(const Names& names);

private:
    /// That of the tab in front; the operation and the parameter page have none.
    std::optional<FileKind> kindInFront() const;
    /// Has the panel open in the folder of that kind.
    void showFolder(BFilePanel& panel, FileKind kind);
    /// Null, after a message, when it cannot be opened.
    std::unique_ptr<InputFile> openOrTell(const std::string& path);
    // Both put what the file holds in the place of what the window has, and tell what came of it. @return whether
    // that is what the file has.
    bool readMarkets(const InputFile& file);
    bool readWallet(const InputFile& file);
    /// Why a portfolio could not be loaded, which is remembered, or what was lost of it; empty when nothing was.
    std::string reportOn(const InputFile& file, bool isRead);
    /// The notice about the file of that kind, in place of the one before; an empty text only takes that away.
    void tell(FileKind kind, const std::string& text);
    /// Why the file that is remembered must not be written over without asking; empty when it may be.
    std::string doubtAbout(FileKind kind) const;

    PLWindow& window_;
    const BTabView& tabs_;
    DataFolder folder_;
    Names names_;
    std::array<std::optional<FileStamp>, 2>
        written_; // by this window last, of each kind: an undo may remember an older one
    BFilePanel openPanel_;
    BFilePanel savePanel_;
};
