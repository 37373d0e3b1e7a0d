#include "cli/report.h"

#include "text/characters.h"

#include <algorithm>
#include <cstdio>

namespace hxa
{

namespace
{

// How many characters a text has; it is valid UTF-8.
std::size_t width(std::string_view text)
{
    return static_cast<std::size_t>(
        std::count_if(text.begin(), text.end(), [](char byte) { return (static_cast<unsigned char>(byte) & 0xC0) != 0x80; }));
}

std::string padded(std::string text, std::size_t size, bool right)
{
    const std::size_t count = size - std::min(size, width(text));
    return right ? text.insert(0, count, ' ') : text.append(count, ' ');
}

bool is_number(const Value& value)
{
    return std::holds_alternative<std::uint64_t>(value.data()) || std::holds_alternative<std::int64_t>(value.data()) ||
           std::holds_alternative<double>(value.data());
}

std::string cell_of(const Value& row, const Column& column)
{
    const Value& value = row.at(column.path);
    return is_number(value) ? cell(value) + column.unit : cell(value);
}

struct To_Cell
{
    std::string operator()(std::nullptr_t) const { return "-"; }
    std::string operator()(bool data) const { return data ? "yes" : "no"; }
    std::string operator()(const std::string& data) const { return data.empty() ? "-" : data; }
    std::string operator()(const List& list) const
    {
        std::string text;
        for (const auto& element : list)
            text += (text.empty() ? "" : " ") + cell(element);
        return text.empty() ? "-" : text;
    }
    std::string operator()(const Object&) const { return "..."; }
    std::string operator()(double data) const
    {
        char text[32];
        std::snprintf(text, sizeof text, "%.1f", data);
        return text;
    }
    template <typename Number> std::string operator()(const Number& number) const { return std::to_string(number); }
};

} // namespace

std::string cell(const Value& value) { return std::visit(To_Cell{}, value.data()); }

std::string table(const List& rows, std::span<const Column> columns)
{
    if (rows.empty())
        return "none\n";
    std::vector<std::string> lines(rows.size() + 2);
    for (const auto& column : columns)
    {
        const bool right =
            std::any_of(rows.begin(), rows.end(), [&](const Value& row) { return is_number(row.at(column.path)); });
        std::vector<std::string> cells{column.heading, ""};
        for (const auto& row : rows)
            cells.push_back(cell_of(row, column));
        std::size_t size = 0;
        for (const auto& text : cells)
            size = std::max(size, width(text));
        cells[1].assign(size, '-');
        for (std::size_t i = 0; i < lines.size(); ++i)
            lines[i] += (lines[i].empty() ? "" : "  ") + padded(cells[i], size, right);
    }
    std::string text;
    for (auto& line : lines)
        text += line.erase(line.find_last_not_of(' ') + 1) + '\n';
    return text;
}

std::string details(const Value& object, std::span<const Column> columns)
{
    std::size_t size = 0;
    for (const auto& column : columns)
        if (!object.at(column.path).is_null())
            size = std::max(size, width(column.heading));
    std::string text;
    for (const auto& column : columns)
        if (!object.at(column.path).is_null())
            text += padded(column.heading, size, false) + "  " + cell_of(object, column) + '\n';
    return text;
}

} // namespace hxa
