#include "platform/Font.h"

#include <QFont>
#include <QFontDatabase>
#include <QFontMetricsF>

namespace {

constexpr float kTextSize = 12;
const BFont plainFont(kTextSize, false);
const BFont boldFont(kTextSize, true);

} // namespace

const BFont* const be_plain_font = &plainFont;
const BFont* const be_bold_font = &boldFont;

QFont BFont::toQt() const
{
    QFont font = QFontDatabase::systemFont(QFontDatabase::GeneralFont);
    // In pixels, not in points: the pages are laid out in pixels, whatever the resolution of the screen.
    font.setPixelSize(static_cast<int>(size_));
    font.setBold(bold_);
    return font;
}

float BFont::StringWidth(const char* text) const
{
    return static_cast<float>(QFontMetricsF(toQt()).horizontalAdvance(QString::fromUtf8(text)));
}

void BFont::GetHeight(font_height* height) const
{
    const QFontMetricsF metrics(toQt());
    height->ascent = static_cast<float>(metrics.ascent());
    height->descent = static_cast<float>(metrics.descent());
}
