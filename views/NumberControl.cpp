#include "views/NumberControl.h"

#include "views/FieldNotice.h"

void NumberControl::askForCount(int largest)
{
    largestCount_ = largest;
    mark();
}

void NumberControl::show(const std::string& text)
{
    SetText(text.c_str());
    shown_ = text;
    // A text that was marked as wrong is gone with this.
    mark();
}

const char* NumberControl::fault() const
{
    const std::string text = Text();
    if (text.empty())
        return nullptr;
    if (!isNumber(text))
        return "is no number";
    if (largestCount_ == 0)
        return nullptr;
    return isCount(text) ? nullptr : "is no whole number";
}

void NumberControl::mark()
{
    const char* what = fault();
    MarkAsInvalid(what == nullptr ? nullptr
                                  : (std::string("This ") + what +
                                     (largestCount_ == 0 ? ", such as 1234.5 or 1234,5" : ", such as 1234"))
                                        .c_str());
}

void NumberControl::TextFinished()
{
    const std::string typed = Text();
    if (typed == shown_ || typed.empty() || fault() != nullptr)
        return; // nothing was typed, or it waits to be mended
    bool isInDoubt;
    if (largestCount_ != 0) {
        setInteger(std::min(getInteger(), largestCount_));
        isInDoubt = readCount(typed) > largestCount_;
    } else {
        setNumber(getNumber());
        isInDoubt = mayMeanThousands(typed);
    }
    if (!isInDoubt)
        return;
    // Of a text that stays as it was the same words would say nothing.
    const std::string read = Text();
    tellAboutField(*this, typed + " was read as " + read + (read != typed ? "" : ", not as thousands"));
}
