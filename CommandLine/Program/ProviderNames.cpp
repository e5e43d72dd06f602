#include "CommandLine/Program/ProviderNames.h"

#include <QFile>
#include <QXmlStreamReader>

namespace spectrel {

namespace {

using Names = std::map<std::string, std::string, std::less<>>;

/// The provider whose element has just begun. Of several providers of a network the primary one counts, else the first.
void readProvider(QXmlStreamReader& xml, Names& names)
{
    const bool isPrimary = xml.attributes().value(QLatin1String("primary")) == QLatin1String("true");
    std::string name;
    while (!xml.atEnd()) {
        const auto token = xml.readNext();
        if (token == QXmlStreamReader::EndElement && xml.name() == QLatin1String("provider"))
            return;
        if (token != QXmlStreamReader::StartElement)
            continue;
        if (xml.name() == QLatin1String("name") && name.empty()) {
            name = xml.readElementText(QXmlStreamReader::SkipChildElements).trimmed().toStdString();
        } else if (xml.name() == QLatin1String("network-id") && !name.empty()) {
            const auto attributes = xml.attributes();
            const std::string network = attributes.value(QLatin1String("mcc")).toString().toStdString() + "-"
                + attributes.value(QLatin1String("mnc")).toString().toStdString();
            if (isPrimary)
                names.insert_or_assign(network, name);
            else
                names.try_emplace(network, name);
        }
    }
}

} // namespace

std::string ProviderNames::nameOf(std::string_view plmn)
{
    if (!_names)
        read();
    const auto known = _names->find(plmn);
    return known == _names->end() ? std::string() : known->second;
}

void ProviderNames::read()
{
    _names.emplace();
    QFile file(QString::fromStdString(_file));
    if (!file.open(QIODevice::ReadOnly))
        return; // not installed: no name is known
    QXmlStreamReader xml(&file);
    while (!xml.atEnd()) {
        if (xml.readNext() == QXmlStreamReader::StartElement && xml.name() == QLatin1String("provider"))
            readProvider(xml, *_names);
    }
}

} // namespace spectrel
