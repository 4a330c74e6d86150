#include "net/ReceivedPage.h"

void ReceivedPage::add(std::string_view bytes)
{
    // `chunk_` takes every byte, hidden ones too: what is not overwritten is repeated when the connection ends.
    for (const char c : bytes) {
        chunk_[used_++] = c;
        hides_ = hides_ || c == '\0';
        if (!hides_)
            text_ += c;
        if (used_ == kChunk)
            endChunk();
    }
    // All of the text is from the server as long as bytes come.
    received_ = text_.size();
}

void ReceivedPage::endWithBreak()
{
    if (used_ == 0)
        return;
    // Behind `used_` stands what is left of the chunk before, up to its first zero byte. `received_` stays in front of
    // it.
    if (!hides_)
        text_ += chunk_ + used_;
    endChunk();
}

void ReceivedPage::endWithClose()
{
    endWithBreak();
    // Each round adds the same text. A chunk that begins with a zero adds none, and is counted instead.
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
