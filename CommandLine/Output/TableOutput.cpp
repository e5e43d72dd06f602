#include "CommandLine/Output/TableOutput.h"

#include "CommandLine/Output/CsvField.h"
#include "CommandLine/Output/JsonWriter.h"

#include <algorithm>
#include <cstdint>

namespace spectrel {

namespace {

/// A value of the serving cell as CSV; nothing where it is not known.
class CellField {
public:
    explicit CellField(std::string& out)
        : _out(out)
    {
        _out += ',';
    }
    void text(std::string_view value)
    {
        appendCsvField(value, _out);
    }
    template <typename Number> void number(const std::optional<Number>& value)
    {
        if (value)
            appendJsonNumber(static_cast<double>(*value), _out);
    }

private:
    std::string& _out;
};

void appendKey(const Cell& cell, CellKey key, CellField field)
{
    switch (key) {
    case CellKey::PLMN:
        return field.text(cell.plmn);
    case CellKey::Operator:
        return field.text(cell.operatorName);
    case CellKey::Area:
        return field.number(cell.area);
    case CellKey::Cell:
        return field.number(cell.cell);
    case CellKey::Site:
        return field.number(cell.site);
    case CellKey::RNC:
        return field.number(cell.rnc);
    case CellKey::Sector:
        return field.number(cell.sector);
    case CellKey::Id:
        return field.number(cell.id);
    case CellKey::Channel:
        return field.number(cell.channel);
    case CellKey::Band:
        return field.text(cell.band);
    case CellKey::DownlinkMHz:
        return field.number(cell.downlinkMHz);
    case CellKey::UplinkMHz:
        return field.number(cell.uplinkMHz);
    case CellKey::BandwidthMHz:
        return field.number(cell.bandwidthMHz);
    default:
        return field.number(cell.levels[static_cast<std::size_t>(key) - static_cast<std::size_t>(CellKey::FirstLevel)]);
    }
}

void appendCellNames(std::string& out)
{
    out += ",technology";
    for (std::size_t key = 0; key < CellKeyCount; ++key)
        (out += ',') += cellKeyName(static_cast<CellKey>(key));
    out += ",age";
}

void appendCell(const Cell* cell, Moment now, std::string& out)
{
    if (!cell) {
        out.append(CellKeyCount + 2, ',');
        return;
    }
    CellField(out).text(radioTechnologyName(cell->technology));
    for (std::size_t key = 0; key < CellKeyCount; ++key)
        appendKey(*cell, static_cast<CellKey>(key), CellField(out));
    const auto age = std::max<std::int64_t>((now - cell->stored).count(), 0);
    CellField(out).number(std::optional(static_cast<double>(age) / 1e6));
}

} // namespace

TableOutput::TableOutput(
    DisplayState& display, OutputWriter& output, const OutputOptions& options, OperatorNames* operators)
    : _display(display)
    , _output(output)
    , _options(options)
{
    if (std::ranges::any_of(options.columns, &TableColumn::isServingCell))
        _analysis.emplace(display, operators);
    if (!_options.hasHeader)
        return;
    _line = _options.file.empty() ? "time" : "file,time";
    for (const TableColumn& column : options.columns) {
        if (column.isServingCell) {
            appendCellNames(_line);
        } else {
            _line += ',';
            appendCsvField(column.name, _line);
        }
    }
    print();
}

void TableOutput::refresh(Moment time)
{
    _line.clear();
    if (!_options.file.empty()) {
        appendCsvField(_options.file, _line);
        _line += ',';
    }
    _line += timeText(time, _options.time);
    for (const TableColumn& column : _options.columns) {
        if (column.isServingCell) {
            appendCell(_analysis->serving(), time, _line);
        } else {
            _line += ',';
            appendCsvField(leafAtPath(_display.display(), column.path).value_or(""), _line);
        }
    }
    print();
}

void TableOutput::print()
{
    _line += '\r'; // as CSV has it, before the line's end
    _output.printLine(_line);
}

} // namespace spectrel
