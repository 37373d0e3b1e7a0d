#include "text/datetime.h"

namespace text
{
namespace
{

constexpr std::size_t sign_position = 21;

// Reads fixed-width decimal fields one after the other; a non-digit makes the whole reading fail.
class Reader
{
public:
    explicit Reader(std::string_view text) : _text(text) {}

    std::uint32_t number(std::size_t width)
    {
        std::uint32_t value = 0;
        for (const char c : _text.substr(0, width))
        {
            _good = _good && c >= '0' && c <= '9';
            value = value * 10 + static_cast<std::uint32_t>(c - '0');
        }
        _text.remove_prefix(width);
        return value;
    }
    void literal(std::string_view expected)
    {
        _good = _good && _text.starts_with(expected);
        _text.remove_prefix(expected.size());
    }
    bool good() const { return _good; }

private:
    std::string_view _text;
    bool _good = true;
};

class Writer
{
public:
    Writer(char* out, bool for_people) : _next(out), _for_people(for_people) {}

    void number(std::uint32_t value, std::size_t width)
    {
        for (std::size_t i = width; i-- > 0; value /= 10)
            _next[i] = static_cast<char>('0' + value % 10);
        _next += width;
    }
    void literal(char c) { *_next++ = c; }
    void separator(char c)
    {
        if (_for_people)
            literal(c);
    }
    char* end() const { return _next; }

private:
    char* _next;
    bool _for_people;
};

} // namespace

std::optional<Datetime_Fields> read_datetime(std::string_view text)
{
    if (text.size() != datetime_size)
        return std::nullopt;
    const char sign = text[sign_position];
    if (sign != ':' && sign != '+' && sign != '-')
        return std::nullopt;

    Reader reader(text);
    Datetime_Fields fields;
    fields.interval = sign == ':';
    if (!fields.interval)
    {
        fields.year = reader.number(4);
        fields.month = reader.number(2);
    }
    fields.day = reader.number(fields.interval ? 8 : 2);
    fields.hour = reader.number(2);
    fields.minute = reader.number(2);
    fields.second = reader.number(2);
    reader.literal(".");
    fields.microsecond = reader.number(6);
    reader.literal({&sign, 1});
    const auto offset = static_cast<std::int32_t>(reader.number(3));
    fields.offset = sign == '-' ? -offset : offset;
    if (!reader.good() || (fields.interval && offset != 0))
        return std::nullopt;
    return fields;
}

char* write_datetime(const Datetime_Fields& fields, char* out, bool for_people)
{
    Writer writer(out, for_people);
    if (!fields.interval)
    {
        writer.number(fields.year, 4);
        writer.separator('/');
        writer.number(fields.month, 2);
        writer.separator('/');
    }
    writer.number(fields.day, fields.interval ? 8 : 2);
    writer.separator(' ');
    writer.number(fields.hour, 2);
    writer.separator(fields.interval ? ' ' : ':');
    writer.number(fields.minute, 2);
    writer.separator(fields.interval ? ' ' : ':');
    writer.number(fields.second, 2);
    writer.literal('.');
    writer.number(fields.microsecond, 6);
    writer.literal(fields.interval ? ':' : fields.offset < 0 ? '-' : '+');
    const auto offset = static_cast<std::uint32_t>(fields.offset);
    writer.number(fields.offset < 0 ? 0U - offset : offset, 3);
    return writer.end();
}

} // namespace text
