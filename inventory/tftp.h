// Files from TFTP servers (RFC 1350), fetched by the host's command line client.
//
// Both the server and the file are named by clients, and the commands run with the rights of the CIM server: nothing that the
// shell, "rm" or "tftp" would read as something else than one server and one plain file name reaches them.
#pragma once

#include "runtime/string.h"

#include <optional>

namespace zmlr
{

struct Tftp_Address
{
    String server;
    String file;
};

// The address in what follows "tftp://": a server of at least two characters, a slash, a file. None when a part is missing,
// begins with '-' or holds a character that steers a terminal (text/safe_text.h), when the file begins with '.' or holds '/', ':'
// or "..", and when a command would be longer than 1023 bytes.
std::optional<Tftp_Address> parse_tftp_address(const String& text);

namespace ProviderUtil
{

// Fetches the file into the working directory, where one of that name is removed first. The exit status of the transfer;
// something else than 0 also when the old file stays, when what came is empty or no plain file, and for names that are no
// address. The client does not tell all failures: a status of 0 without a file is one too. By its own default it gives up 25 s
// after the last sign of life of the server; ours is that a transfer is ended after 5 minutes.
//
// By its default, too, the client asks for "netascii" and turns CR LF into LF and CR NUL into CR in whatever comes. The server
// has to send it in that form: a server that sends the bytes of the file as they are spoils an image with such pairs in it, and
// in the last image of an archive, which may become shorter, nobody notices.
//
// The file is the caller's to remove; a transfer that fails leaves none.
int TftpGetFile(const char* server, const char* file);

} // namespace ProviderUtil

// Removes a fetched file at the end of its life.
struct Fetched_File
{
    Fetched_File() = default;
    ~Fetched_File();
    Fetched_File(const Fetched_File&) = delete;
    Fetched_File& operator=(const Fetched_File&) = delete;

    String name; // empty while nothing was fetched
};

} // namespace zmlr
