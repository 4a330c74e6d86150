#include "tools/JsonWriter.h"

#include "foundation/Date.h"

#include <cmath>
#include <cstdio>
#include <nlohmann/json.hpp>
#include <string>

namespace {

constexpr int kIndent = 2;

std::string quoted(std::string_view bytes)
{
    return nlohmann::json(bytes).dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

} // namespace

void JsonWriter::begin(char opening, char closing, Layout layout)
{
    putValue({&opening, 1});
    levels_.push_back({closing, layout});
}

void JsonWriter::end()
{
    const Level level = levels_.back();
    levels_.pop_back();
    if (level.layout == Layout::kLinePerItem && !level.isEmpty)
        beginLine();
    put({&level.closing, 1});
    if (levels_.empty())
        put("\n");
}

/// What stands between the former value and the one to come.
void JsonWriter::separate()
{
    if (keyed_) {
        keyed_ = false;
        return;
    }
    if (levels_.empty())
        return;
    Level& level = levels_.back();
    if (!level.isEmpty)
        put(level.layout == Layout::kOneLine ? ", " : ",");
    if (level.layout == Layout::kLinePerItem)
        beginLine();
    level.isEmpty = false;
}

void JsonWriter::beginLine()
{
    put("\n" + std::string(levels_.size() * kIndent, ' '));
}

void JsonWriter::put(std::string_view text)
{
    std::fwrite(text.data(), 1, text.size(), out_);
}

void JsonWriter::putValue(std::string_view value)
{
    separate();
    put(value);
}

JsonWriter& JsonWriter::key(std::string_view name)
{
    putValue(quoted(name) + ": ");
    keyed_ = true;
    return *this;
}

void JsonWriter::text(std::string_view bytes)
{
    putValue(quoted(bytes));
}

void JsonWriter::number(float value)
{
    if (!std::isfinite(value)) {
        null();
        return;
    }
    char digits[32];
    std::snprintf(digits, sizeof digits, "%.9g", static_cast<double>(value));
    const bool looksWhole = std::string_view(digits).find_first_of(".e") == std::string_view::npos;
    putValue(std::string(digits) + (looksWhole ? ".0" : "")); // a float stays one, and -0 keeps its sign
}

void JsonWriter::number(int value)
{
    putValue(std::to_string(value));
}

void JsonWriter::boolean(bool value)
{
    putValue(value ? "true" : "false");
}

void JsonWriter::null()
{
    putValue("null");
}

void JsonWriter::date(const Date& date)
{
    if (date.isUndefined())
        null();
    else
        text(date.toString().bytes());
}
