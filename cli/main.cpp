// hxa: the adapters of this host on the command line, without a CIM server.
#include "cli/command_line.h"
#include "cli/session.h"

#include <exception>
#include <iostream>

namespace
{

int fail(hxa::Exit code, const char* what)
{
    std::cerr << "hxa: " << what << '\n';
    return static_cast<int>(code);
}

} // namespace

int main(int count, char** words)
{
    try
    {
        const auto command_line = hxa::read_command_line(count, words);
        if (!command_line.run)
        {
            if (!((command_line.code == hxa::Exit::done ? std::cout : std::cerr) << command_line.text << std::flush))
                return static_cast<int>(hxa::Exit::refused);
            return static_cast<int>(command_line.code);
        }
        hxa::Session session(command_line.common);
        command_line.run(session);
        return static_cast<int>(session.code());
    }
    catch (const hxa::Failure& failure)
    {
        return fail(failure.code(), failure.what());
    }
    catch (const std::exception& error)
    {
        return fail(hxa::Exit::refused, error.what());
    }
}
