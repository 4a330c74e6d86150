#pragma once

#include "platform/SupportDefs.h"

#include <string>

class BMessage;
class BWindow;
class PLWindow;

/// Opens the guide in the browser: pages of HTML that stand beside the program, made of docs/GUIDE.md by
/// packaging/guide/make. Where that fails, a notice says which file it is.
class Guide {
public:
    /// The code that opens it, at the page that the text "page" names; without one, at that of the page in front.
    static constexpr uint32 kOpen = 'HGui';
    /// The code by which it hears that no browser has started.
    static constexpr uint32 kFailed = 'HGuF';
    /// Its beginning. The other names are those of the pages, and of windows that have a part of it.
    static constexpr const char* kStart = "index";

    /// `window` outlives this.
    explicit Guide(PLWindow& window) : window_(window) {}

    /// F1 opens it at `page`, or at that of the page in front when that is null, while `inWindow` has the keyboard.
    void addKey(BWindow& inWindow, const char* page = nullptr);
    void open(const std::string& page);
    void tellFailure(const BMessage* message);

private:
    void tell(const std::string& text);

    PLWindow& window_;
};
