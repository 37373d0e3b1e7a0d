#include "hxal/internal/boot_archive.h"

#include "hxal/internal/regular_file.h"
#include "hxal/internal/tar_archive.h"

namespace hxal
{

namespace
{

constexpr const char* description_name = "boot.txt";
constexpr const char* temporary_path = "./zmlrtmpfile";
constexpr size_t max_description_size = 1024 * 1024;

bool is_description(const Tar_Member& member) { return member.name.find(description_name) != member.name.npos; }

bool rewind(int fd) { return ::lseek(fd, 0, SEEK_SET) == 0; }

// The unpacked inner archive: a new file of ours for as long as this lives. What stands in its place beforehand is
// unlinked, and what is planted there in the meantime is not opened.
class Temporary_File
{
public:
    Temporary_File()
        : _unlinked(::unlink(temporary_path))
        , _file(temporary_path, O_RDWR | O_CREAT | O_EXCL | O_NOFOLLOW, S_IRUSR | S_IWUSR)
    {
    }

    ~Temporary_File()
    {
        if (_file.is_open())
            ::unlink(temporary_path);
    }

    Temporary_File(const Temporary_File&) = delete;
    Temporary_File& operator=(const Temporary_File&) = delete;

    // Leaves the file at its start. False when it could not be created or written.
    bool fill(const Image& bytes) const
    {
        return _file.is_open() && write_all(_file.number(), bytes.data(), bytes.size()) && rewind(_file.number());
    }

    int number() const { return _file.number(); }

private:
    int _unlinked;
    Descriptor _file;
};

hxa_status_t read_config_file(Tar_Reader& reader, std::vector<HXAL_IMAGE_DATA_T>& images)
{
    Tar_Member member;
    if (const hxa_status_t read = reader.next(member); read != HXA_STATUS_OK)
        return read;
    if (!is_description(member))
        return HXA_STATUS_FAILED;
    if (member.data.size() > max_description_size)
        return HXA_STATUS_ENOMEM;
    return read_boot_description({reinterpret_cast<const char*>(member.data.data()), member.data.size()}, images);
}

hxa_status_t read_image_files(Tar_Reader& reader, std::vector<HXAL_IMAGE_DATA_T>& images)
{
    Tar_Member member;
    size_t total = 0;
    for (HXAL_IMAGE_DATA_T& image : images)
    {
        if (const hxa_status_t read = reader.next(member); read != HXA_STATUS_OK)
            return read;
        total += member.data.size();
        if (total > max_image_size)
            return HXA_STATUS_ENOMEM;
        image.ibuf.swap(member.data);
    }
    return HXA_STATUS_OK;
}

// Reads the archive that an open file is, from its start: the description, then one member for each image of it.
hxa_status_t populate_data_from_file(int fd, std::vector<HXAL_IMAGE_DATA_T>& images)
{
    Tar_Reader reader(fd);
    const hxa_status_t read = read_config_file(reader, images);
    return read == HXA_STATUS_OK ? read_image_files(reader, images) : read;
}

// Reads the first member, the description or an archive inside.
hxa_status_t check_file_contains_tar(const Regular_File& file, Tar_Member& first)
{
    if (file.exists() && !file.is_regular())
        return HXA_STATUS_BAD_FILE;
    return file.is_open() ? Tar_Reader(file.number()).next(first) : HXA_STATUS_FAILED;
}

} // namespace

hxa_status_t read_boot_archive(const char* path, std::vector<HXAL_IMAGE_DATA_T>& images)
{
    const Regular_File file(path);
    Tar_Member first;
    if (const hxa_status_t read = check_file_contains_tar(file, first); read != HXA_STATUS_OK)
        return read;
    if (is_description(first))
        return rewind(file.number()) ? populate_data_from_file(file.number(), images) : HXA_STATUS_BAD_FILE;
    const Temporary_File inner;
    return inner.fill(first.data) ? populate_data_from_file(inner.number(), images) : HXA_STATUS_CREATE_FILE;
}

} // namespace hxal
