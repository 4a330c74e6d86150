#include "foundation/FieldIO.h"

#include <bit>
#include <cstring>
#include <sys/socket.h>

// Each stream belongs to one reader or writer, so the unlocked calls serve: a file has millions of fields.

float decodeFloat(const unsigned char* bytes)
{
    return std::bit_cast<float>(decodeInt(bytes));
}

void encodeShort(unsigned char* bytes, std::uint16_t value)
{
    bytes[0] = static_cast<unsigned char>(value & 0xFF);
    bytes[1] = static_cast<unsigned char>(value >> 8);
}

void encodeInt(unsigned char* bytes, std::uint32_t value)
{
    for (int i = 0; i < 4; ++i)
        bytes[i] = static_cast<unsigned char>(value >> (8 * i) & 0xFF);
}

void encodeFloat(unsigned char* bytes, float value)
{
    encodeInt(bytes, std::bit_cast<std::uint32_t>(value));
}

void freadbytes(FILE* file, unsigned char* bytes, std::size_t size)
{
    const std::size_t got = fread_unlocked(bytes, 1, size, file);
    std::memset(bytes + got, 0xFF, size - got);
}

bool reachedEnd(FILE* file)
{
    return std::feof(file) != 0 || std::ferror(file) != 0;
}

unsigned short freadshort(FILE* file)
{
    unsigned char bytes[2];
    freadbytes(file, bytes, sizeof bytes);
    return decodeShort(bytes);
}

void fwriteshort(FILE* file, unsigned short value)
{
    unsigned char bytes[2];
    encodeShort(bytes, value);
    fwrite_unlocked(bytes, 1, sizeof bytes, file);
}

int freadint(FILE* file)
{
    unsigned char bytes[4];
    freadbytes(file, bytes, sizeof bytes);
    return static_cast<int>(decodeInt(bytes));
}

void fwriteint(FILE* file, int value)
{
    unsigned char bytes[4];
    encodeInt(bytes, static_cast<std::uint32_t>(value));
    fwrite_unlocked(bytes, 1, sizeof bytes, file);
}

float freadfloat(FILE* file)
{
    unsigned char bytes[4];
    freadbytes(file, bytes, sizeof bytes);
    return decodeFloat(bytes);
}

void fwritefloat(FILE* file, float value)
{
    unsigned char bytes[4];
    encodeFloat(bytes, value);
    fwrite_unlocked(bytes, 1, sizeof bytes, file);
}

unsigned char freadchar(FILE* file)
{
    unsigned char byte;
    freadbytes(file, &byte, 1);
    return byte;
}

void fwritechar(FILE* file, unsigned char value)
{
    std::fputc(value, file);
}

int sgetc(char* c, int socket)
{
    return static_cast<int>(recv(socket, c, 1, 0));
}
