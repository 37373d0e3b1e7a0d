#include "hxal/internal/boot_description.h"

#include <algorithm>
#include <charconv>
#include <string>

namespace hxal
{

namespace
{

std::string without_blanks(std::string_view text)
{
    std::string kept(text);
    std::erase_if(kept, [](char each) { return each == ' ' || each == '\t' || each == '\r'; });
    return kept;
}

// Takes the text up to a separator, and the separator, off the front of another.
std::string_view take(std::string_view& text, char separator)
{
    const size_t end = std::min(text.find(separator), text.size());
    const std::string_view front = text.substr(0, end);
    text.remove_prefix(std::min(end + 1, text.size()));
    return front;
}

// Hexadecimal numbers, with or without "0x", with commas between them; false when there is none, or one that is no number of
// that size.
template <typename Number> bool read_numbers(std::string_view text, std::vector<Number>& numbers)
{
    numbers.clear();
    do
    {
        std::string_view digits = take(text, ',');
        if (digits.starts_with("0x") || digits.starts_with("0X"))
            digits.remove_prefix(2);
        Number number;
        const auto [end, error] = std::from_chars(digits.begin(), digits.end(), number, 16);
        if (error != std::errc() || end != digits.end())
            return false;
        numbers.push_back(number);
    } while (!text.empty());
    return true;
}

Image_Type type_of(std::string_view value)
{
    switch (value.empty() ? '\0' : value.front())
    {
    case 'O':
        return image_option_rom;
    case 'F':
        return image_firmware;
    case 'C':
        return image_firmware_configuration;
    case 'L':
        return image_boot_overlay;
    default:
        return image_ignored;
    }
}

// Reads a description line by line.
class Description_Reader
{
public:
    explicit Description_Reader(std::vector<HXAL_IMAGE_DATA_T>& images) : _images(images) {}

    bool read_line(std::string_view line);
    bool at_end() const { return !_images.empty() && !_open; }

private:
    bool begin_image();
    bool read_type(std::string_view value);
    bool read_ids(std::string_view value);
    bool read_ports(std::string_view value);
    bool close_when_complete();

    std::vector<HXAL_IMAGE_DATA_T>& _images;
    bool _open = false; // the last image is being described
    bool _has_type = false;
    bool _has_ids = false;
    bool _has_ports = false;
};

bool Description_Reader::begin_image()
{
    if (_open)
        return false;
    _images.emplace_back().iport = {0};
    _open = true;
    _has_type = _has_ids = _has_ports = false;
    return true;
}

bool Description_Reader::read_type(std::string_view value)
{
    if (_has_type)
        return false;
    _images.back().itype = type_of(value);
    _has_type = true;
    return close_when_complete();
}

bool Description_Reader::read_ids(std::string_view value)
{
    if (_has_ids || !read_numbers(value, _images.back().idevice))
        return false;
    _has_ids = true;
    return close_when_complete();
}

bool Description_Reader::read_ports(std::string_view value)
{
    if (_has_ports || !read_numbers(value, _images.back().iport))
        return false;
    _has_ports = true;
    return true;
}

bool Description_Reader::close_when_complete()
{
    _open = !(_has_type && _has_ids);
    return true;
}

bool Description_Reader::read_line(std::string_view line)
{
    struct Line_Kind
    {
        std::string_view word;
        bool (Description_Reader::*read)(std::string_view value);
    };
    constexpr Line_Kind kinds[] = {
        {"TYPE", &Description_Reader::read_type},
        {"ID", &Description_Reader::read_ids},
        {"PORT", &Description_Reader::read_ports},
    };

    if (line.find("IMAGE") != line.npos)
        return begin_image();
    const auto* kind =
        std::find_if(std::begin(kinds), std::end(kinds), [=](const Line_Kind& row) { return line.find(row.word) != line.npos; });
    if (kind == std::end(kinds))
        return true;
    const size_t equals = line.find('=');
    return _open && equals != line.npos && (this->*kind->read)(without_blanks(line.substr(equals + 1)));
}

} // namespace

bool HXAL_IMAGE_DATA_T::is_for(uint16_t devid) const { return std::find(idevice.begin(), idevice.end(), devid) != idevice.end(); }

hxa_status_t read_boot_description(std::string_view text, std::vector<HXAL_IMAGE_DATA_T>& images)
{
    Description_Reader reader(images);
    while (!text.empty())
        if (!reader.read_line(take(text, '\n')))
            return HXA_STATUS_FAILED;
    return reader.at_end() ? HXA_STATUS_OK : HXA_STATUS_FAILED;
}

} // namespace hxal
