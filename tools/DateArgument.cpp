#include "tools/DateArgument.h"

#include "tools/DateText.h"
#include "tools/Today.h"

std::string checkDateArgument(const std::string& text)
{
    const bool isDate = text.find('/') != std::string::npos && parseDate(text);
    return isDate ? std::string() : "is not a date DD/MM/YYYY: " + text;
}

Date dateArgument(const std::string& text)
{
    return text.empty() ? today() : *parseDate(text);
}
