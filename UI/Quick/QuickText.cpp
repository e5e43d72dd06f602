#include "UI/Quick/QuickText.h"

#include <QGuiApplication>

#include <algorithm>
#include <cmath>

namespace spectrel {

namespace {

constexpr qsizetype LongestLine = 8192; // characters; a line of them is about 80,000 px long
constexpr std::size_t LongestBytes = 4 * LongestLine;

bool isControl(QChar character)
{
    return character.unicode() < 0x20 || (character.unicode() >= 0x7F && character.unicode() < 0xA0)
        || character == QChar::LineSeparator || character == QChar::ParagraphSeparator;
}

} // namespace

QString shownText(std::string_view text)
{
    QString line = QString::fromUtf8(text.data(), static_cast<qsizetype>(std::min(text.size(), LongestBytes)));
    if (line.size() > LongestLine)
        line = line.first(LongestLine) + QChar(0x2026);
    std::replace_if(line.begin(), line.end(), isControl, QChar(0xFFFD));
    return line;
}

QFont shownFont(const Font& font)
{
    QFont shown = QGuiApplication::font();
    if (!font.family.empty())
        shown.setFamily(QString::fromStdString(font.family));
    shown.setPixelSize(static_cast<int>(std::lround(font.points)));
    shown.setBold(font.weight == FontWeight::Bold);
    return shown;
}

} // namespace spectrel
