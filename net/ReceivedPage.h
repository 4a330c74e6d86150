#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// The text of a page, out of the bytes that a server sends. It depends on the bytes alone, and not on the pieces in
/// which the network brings them.
///
/// The bytes are taken in chunks of 256, of which a zero byte hides the rest. Where the server ends the connection, the
/// last chunk keeps the end of the one before it, and is repeated. Intended: a page always fills up, and what the
/// parsers look for stands in front. But no price is cut out of repetitions, which would make 12.57 of 12.5.
class ReceivedPage {
public:
    /// Takes chunks until the text is longer than `limit` characters; it then exceeds that by 256 at most.
    explicit ReceivedPage(std::size_t limit) : limit_(limit) {}

    /// How many bytes it takes next; 0 when it is full.
    std::size_t room() const { return isFull() ? 0 : kChunk - used_; }
    /// Takes at most `room` bytes.
    void add(std::string_view bytes);

    /// The connection was broken: a chunk that was begun is filled up with the one before.
    void endWithBreak();
    /// The server has closed the connection: the page is filled up with the last chunk.
    void endWithClose();

    const std::string& text() const { return text_; }
    /// The text in front of all repetitions.
    std::string_view received() const { return std::string_view(text_).substr(0, received_); }

private:
    static constexpr std::size_t kChunk = 256;

    /// It ends between two chunks only. A server that has closed without a word, or that sends zeros, adds nothing for
    /// ever.
    bool isFull() const { return used_ == 0 && (text_.size() > limit_ || empty_ > limit_); }
    void endChunk();

    std::size_t limit_;
    std::string text_;
    std::size_t received_ = 0;
    char chunk_[kChunk + 1] = {}; // the last one as far as it has come, behind that the one before, and a zero
    std::size_t used_ = 0;        // bytes of the chunk that have come
    bool hides_ = false;          // a zero byte has come in this chunk
    std::size_t empty_ = 0;       // chunks without text
};
