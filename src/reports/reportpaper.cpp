#include "reports/reportpaper.h"

#include "services/clsRegistry.h"

#include <QLocale>
#include <QRectF>

using namespace Qt::StringLiterals;

namespace reportpaper
{

namespace
{

constexpr int usualMargin = 15;
const QString key = QString(settingsKey) + u"\\Reports"_s;
const auto sizeName = u"Paper"_s, landscapeName = u"Landscape"_s;
const QString marginNames[] = {u"MarginLeft"_s, u"MarginTop"_s, u"MarginRight"_s,
                               u"MarginBottom"_s};

QPageSize::PageSizeId usualSize()
{
    const bool american = QLocale::system().measurementSystem() == QLocale::ImperialUSSystem;
    return american ? QPageSize::Letter : QPageSize::A4;
}

QPageSize::PageSizeId sizeOf(const QString &name)
{
    for (const Size &size : sizes()) {
        if (name == QLatin1String(size.name))
            return size.id;
    }
    return usualSize();
}

const char *nameOf(QPageSize::PageSizeId id)
{
    for (const Size &size : sizes()) {
        if (size.id == id)
            return size.name;
    }
    return "";
}

int marginFrom(const QVariant &value)
{
    return value.typeId() == QMetaType::Int ? value.toInt() : usualMargin;
}

} // namespace

const std::vector<Size> &sizes()
{
    static const std::vector<Size> all{
        {QPageSize::A3, "A3"},           {QPageSize::A4, "A4"},
        {QPageSize::A5, "A5"},           {QPageSize::B5, "B5"},
        {QPageSize::Letter, "Letter"},   {QPageSize::Legal, "Legal"},
        {QPageSize::Tabloid, "Tabloid"}, {QPageSize::Executive, "Executive"}};
    return all;
}

int largestMargin(double side)
{
    return int(side / 4);
}

QPageLayout layout(QPageSize::PageSizeId size, QPageLayout::Orientation orientation,
                   const QMargins &margins)
{
    QPageLayout paper(QPageSize(size), orientation, {}, QPageLayout::Millimeter);
    paper.setMode(QPageLayout::FullPageMode);
    const QSizeF sheet = paper.fullRect(QPageLayout::Millimeter).size();
    const int across = largestMargin(sheet.width()), down = largestMargin(sheet.height());
    paper.setMargins({double(std::clamp(margins.left(), smallestMargin, across)),
                      double(std::clamp(margins.top(), smallestMargin, down)),
                      double(std::clamp(margins.right(), smallestMargin, across)),
                      double(std::clamp(margins.bottom(), smallestMargin, down))});
    return paper;
}

QPageLayout stored()
{
    clsRegistry settings;
    const auto value = [&settings](const QString &name) { return settings.GetValue(key, name); };
    const bool landscape = value(landscapeName).toInt() == 1;
    return layout(sizeOf(value(sizeName).toString()),
                  landscape ? QPageLayout::Landscape : QPageLayout::Portrait,
                  {marginFrom(value(marginNames[0])), marginFrom(value(marginNames[1])),
                   marginFrom(value(marginNames[2])), marginFrom(value(marginNames[3]))});
}

void store(const QPageLayout &paper)
{
    clsRegistry settings;
    settings.CreateKey(key);
    settings.SetValue(key, sizeName, QString::fromLatin1(nameOf(paper.pageSize().id())));
    settings.SetValue(key, landscapeName, int(paper.orientation() == QPageLayout::Landscape));
    const QMarginsF margins = paper.margins(QPageLayout::Millimeter);
    const double sides[] = {margins.left(), margins.top(), margins.right(), margins.bottom()};
    for (int i = 0; i < 4; ++i)
        settings.SetValue(key, marginNames[i], qRound(sides[i]));
}

} // namespace reportpaper
