// What a function writes to the stream it is given.
#pragma once

#include <cstdio>
#include <cstdlib>
#include <string>

template <class Print> std::string printed(Print print)
{
    char* text = nullptr;
    std::size_t size = 0;
    std::FILE* stream = open_memstream(&text, &size);
    print(stream);
    std::fclose(stream);
    const std::string result(text, size);
    std::free(text);
    return result;
}
