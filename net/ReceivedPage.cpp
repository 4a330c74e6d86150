#include "net/ReceivedPage.h"

void ReceivedPage::add(std::string_view bytes)
{
    for (const char c : bytes) {
        chunk_[used_++] = c;
        hides_ = hides_ || c == '\0';
        if (!hides_)
            text_ += c;
        if (used_ == kChunk)
            endChunk();
    }
    received_ = text_.size();
}

void ReceivedPage::endWithBreak()
{
    if (used_ == 0)
        return;
    if (!hides_)
        text_ += chunk_ + used_;
    endChunk();
}

void ReceivedPage::endWithClose()
{
    endWithBreak();
    while (!isFull()) {
        text_ += chunk_;
        endChunk();
    }
}

void ReceivedPage::endChunk()
{
    empty_ += chunk_[0] == '\0' ? 1 : 0;
    used_ = 0;
    hides_ = false;
}
