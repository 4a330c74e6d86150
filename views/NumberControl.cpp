#include "views/NumberControl.h"

void NumberControl::show(const std::string& text)
{
    SetText(text.c_str());
    // A text that was marked as wrong is gone with this.
    mark();
}

void NumberControl::mark()
{
    const bool isWrong = *Text() != '\0' && !isNumber(Text());
    MarkAsInvalid(isWrong ? "This is no number, such as 1234.5 or 1234,5" : nullptr);
}
