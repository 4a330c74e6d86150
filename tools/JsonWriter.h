#pragma once

#include <cstdio>
#include <string_view>
#include <vector>

class Date;

/// Writes JSON text to a file: values in the order of the calls, commas and line ends by itself. Failures to write are
/// left to the file's own error mark.
///
/// Floats have 9 significant digits at most, which read back to the same float. They are written here because the JSON
/// library shows a few of such numbers with 17 digits; it serves for texts.
class JsonWriter {
public:
    /// `out` stays the caller's.
    explicit JsonWriter(FILE* out) : out_(out) {}

    enum class Layout { kOneLine, kLinePerItem };

    void beginObject(Layout layout = Layout::kOneLine) { begin('{', '}', layout); }
    void beginArray(Layout layout = Layout::kLinePerItem) { begin('[', ']', layout); }
    /// Closes the object or array begun last.
    void end();

    /// The name of the next value; between `beginObject` and its `end`.
    JsonWriter& key(std::string_view name);
    /// Bytes that are no UTF-8 become U+FFFD.
    void text(std::string_view bytes);
    /// A number that is not finite is null.
    void number(float value);
    void number(int value);
    void boolean(bool value);
    void null();
    /// DD/MM/YYYY; null for the undefined date.
    void date(const Date& date);

private:
    struct Level {
        char closing;
        Layout layout;
        bool isEmpty = true;
    };

    void begin(char opening, char closing, Layout layout);
    void separate();
    void beginLine();
    void put(std::string_view text);
    void putValue(std::string_view value);

    FILE* out_;
    std::vector<Level> levels_;
    bool keyed_ = false; // a key has been written, its value not yet
};
