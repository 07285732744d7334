#include "screens/tv/text_measurer.h"

#include <QFontDatabase>
#include <QTextLayout>
#include <algorithm>
#include <cmath>

namespace wp::tv {
namespace {

// Wider than any screen: no limit.
constexpr double kNoLimit = 1e6;

QString shownText(std::string_view text) {
    QString shown = QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
    return shown.replace(QLatin1Char('\n'), QChar::LineSeparator);
}

/// The scene lays texts out by the face's design metrics, so that they come out alike at every unit.
QTextOption optionOf(QTextOption::WrapMode wrapping) {
    QTextOption option;
    option.setWrapMode(wrapping);
    option.setUseDesignMetrics(true);
    return option;
}

}  // namespace

void loadFonts() {
    for (const char* file : {":/fonts/DejaVuSans.ttf", ":/fonts/DejaVuSans-Bold.ttf"})
        QFontDatabase::addApplicationFont(QString::fromLatin1(file));
}

QFont fontOf(const ui::Font& font) {
    QFont face(QString::fromLatin1(kFontFamily));
    face.setPixelSize(std::max(1, static_cast<int>(std::lround(font.size))));
    face.setHintingPreference(QFont::PreferNoHinting);
    return face;
}

ui::TextSize TextMeasurer::measure(std::string_view text, const ui::Font& font, double width,
                                   int maxLines) const {
    if (text.empty()) return {};
    QTextLayout layout(shownText(text), fontOf(font));
    layout.setTextOption(optionOf(QTextOption::WrapAtWordBoundaryOrAnywhere));
    ui::TextSize measured;
    int lines = 0;
    layout.beginLayout();
    for (QTextLine line = layout.createLine(); line.isValid(); line = layout.createLine()) {
        line.setLineWidth(width > 0 ? width : kNoLimit);
        if (maxLines > 0 && ++lines > maxLines) {
            measured.fits = false;
            continue;
        }
        ++measured.lines;
        measured.size.width = std::max(measured.size.width, line.naturalTextWidth());
        measured.size.height += line.height();
        measured.descent = line.descent();
    }
    layout.endLayout();
    measured.size = {std::ceil(measured.size.width), std::ceil(measured.size.height)};
    return measured;
}

double balancedWidth(const ui::TextMeasurer& measurer, const QString& text, const ui::Font& font,
                     double width) {
    auto measure = [&](const QString& part, double limit) {
        return measurer.measure(part.toStdString(), font, limit, 0);
    };
    auto linesAt = [&](double limit) { return measure(text, limit).lines; };
    int lines = linesAt(width);
    if (lines < 2) return width;
    double narrow = width / lines;
    for (const QString& word : text.split(QLatin1Char(' ')))
        narrow = std::max(narrow, measure(word, 0).size.width);
    double wide = width;
    while (wide - narrow > 4) {
        double middle = (narrow + wide) / 2;
        (linesAt(middle) > lines ? narrow : wide) = middle;
    }
    // Sizes are rounded to dots when a coarse screen draws them.
    return std::min(width, 1.03 * wide);
}

double cursorPosition(const QString& text, int position, const ui::Font& font) {
    QTextLayout layout(text, fontOf(font));
    layout.setTextOption(optionOf(QTextOption::NoWrap));
    layout.beginLayout();
    QTextLine line = layout.createLine();
    if (line.isValid()) line.setLineWidth(kNoLimit);
    layout.endLayout();
    return line.isValid() ? line.cursorToX(position) : 0;
}

}  // namespace wp::tv
