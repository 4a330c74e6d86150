#include "platform/FoldedText.h"

#include <QString>

#include <algorithm>

std::string foldedText(std::string_view text)
{
    const auto isPlain = [](char c) { return static_cast<unsigned char>(c) < 0x80; };
    if (std::ranges::all_of(text, isPlain)) {
        // Nearly all texts, and there may be many.
        std::string folded(text);
        for (char& c : folded)
            c = c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
        return folded;
    }
    // A letter with an accent becomes the letter and the accent behind it, which goes.
    const QString parts = QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()))
                              .normalized(QString::NormalizationForm_KD)
                              .toCaseFolded();
    QString folded;
    std::ranges::copy_if(parts, std::back_inserter(folded), [](QChar c) { return !c.isMark(); });
    return folded.toStdString();
}
