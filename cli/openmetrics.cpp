#include "cli/openmetrics.h"

#include "metrics/families.h"
#include "text/characters.h"

#include <cerrno>
#include <cstdlib>
#include <set>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>

namespace hxa::openmetrics
{

namespace
{

std::string escaped(std::string_view value)
{
    std::string result;
    while (!value.empty())
    {
        const std::size_t size = text::xml_character_size(value);
        if (size == 0)
            result += '?';
        else if (value.front() == '\n')
            result += "\\n";
        else if (value.front() == '\\' || value.front() == '"')
            result.append({'\\', value.front()});
        else
            result += value.substr(0, size);
        value.remove_prefix(size == 0 ? 1 : size);
    }
    return result;
}

std::string labels_of(const Family& family, const Sample& sample)
{
    std::string result;
    for (std::size_t i = 0; i < sample.labels.size() && i < family.labels.size(); ++i)
    {
        if (!sample.labels[i].empty())
            result.append(result.empty() ? "{" : ",").append(family.labels[i]).append("=\"" + escaped(sample.labels[i]) + '"');
    }
    return result.empty() ? result : result + '}';
}

std::string_view without(std::string_view name, std::string_view suffix)
{
    return name.ends_with(suffix) ? name.substr(0, name.size() - suffix.size()) : name;
}

// The lines above a family's samples. Only OpenMetrics knows infos.
std::string head_of(const Family& family, Form form)
{
    const bool is_openmetrics = form == Form::openmetrics;
    const std::string name(is_openmetrics ? without(without(family.name, "_total"), "_info") : family.name);
    const char* const type = family.type == Type::counter                  ? "counter"
                             : family.type == Type::info && is_openmetrics ? "info"
                                                                           : "gauge";
    std::string head = "# HELP " + name + ' ' + std::string(family.help) + "\n# TYPE " + name + ' ' + type + '\n';
    if (is_openmetrics && !family.unit.empty())
        head += "# UNIT " + name + ' ' + std::string(family.unit) + '\n';
    return head;
}

// A new file of nobody else's beside the one that it is to become.
class Temporary_File
{
public:
    explicit Temporary_File(const std::string& path) : _path(path), _name(path + ".XXXXXX"), _descriptor(mkstemp(_name.data()))
    {
        check(_descriptor);
    }
    ~Temporary_File()
    {
        if (_descriptor >= 0)
            close(_descriptor);
        if (!_name.empty())
            unlink(_name.c_str());
    }
    Temporary_File(const Temporary_File&) = delete;
    Temporary_File& operator=(const Temporary_File&) = delete;

    void write(std::string_view text)
    {
        while (!text.empty())
        {
            const ssize_t written = ::write(_descriptor, text.data(), text.size());
            check(written);
            text.remove_prefix(static_cast<std::size_t>(written));
        }
        check(fchmod(_descriptor, S_IRUSR | S_IWUSR | S_IRGRP | S_IROTH));
        check(fsync(_descriptor));
    }

    void take_place()
    {
        check(rename(_name.c_str(), _path.c_str()));
        _name.clear();
    }

private:
    void check(ssize_t result) const
    {
        if (result < 0)
            throw std::system_error(errno, std::generic_category(), "cannot write " + _path);
    }

    const std::string _path;
    std::string _name; // empty when there is no such file any more
    int _descriptor;
};

} // namespace

Form form_for(std::string_view path) { return path.ends_with(".prom") ? Form::collector : Form::openmetrics; }

std::string text_of(std::span<const Sample> samples, Form form)
{
    std::string result;
    for (const Family& family : families)
    {
        std::set<std::string> written;
        for (const Sample& sample : samples)
        {
            if (sample.family != family.name)
                continue;
            const std::string series = std::string(family.name) + labels_of(family, sample);
            if (written.empty())
                result += head_of(family, form);
            if (written.insert(series).second)
                result += series + ' ' + std::to_string(sample.value) + '\n';
        }
    }
    return result + "# EOF\n";
}

void write_file(const std::string& path, std::string_view text)
{
    struct stat there = {};
    if (lstat(path.c_str(), &there) == 0 && !S_ISREG(there.st_mode))
        throw std::runtime_error("cannot write " + path + ": it is no regular file");
    Temporary_File file(path);
    file.write(text);
    file.take_place();
}

} // namespace hxa::openmetrics
