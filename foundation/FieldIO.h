#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>

/// Fields of the data files: little-endian, without tags, padding or alignment.
///
/// The readers report no error; every byte past the end of the file reads as 0xFF. `reachedEnd` tells afterwards.

unsigned short freadshort(FILE* file);
void fwriteshort(FILE* file, unsigned short value);

int freadint(FILE* file);
void fwriteint(FILE* file, int value);

/// IEEE-754 single, as its 32 bits stand.
float freadfloat(FILE* file);
void fwritefloat(FILE* file, float value);

unsigned char freadchar(FILE* file);
void fwritechar(FILE* file, unsigned char value);

/// True once a read of `file` went past its end, or failed: the field read last is then not whole.
bool reachedEnd(FILE* file);

/// Reads `size` bytes; those past the end of the file are set to 0xFF.
void freadbytes(FILE* file, unsigned char* bytes, std::size_t size);

/// The same fields in memory, for records that are read and written in one piece.
inline std::uint16_t decodeShort(const unsigned char* bytes)
{
    return static_cast<std::uint16_t>(bytes[0] | bytes[1] << 8);
}

inline std::uint32_t decodeInt(const unsigned char* bytes)
{
    return static_cast<std::uint32_t>(bytes[0]) | static_cast<std::uint32_t>(bytes[1]) << 8 |
           static_cast<std::uint32_t>(bytes[2]) << 16 | static_cast<std::uint32_t>(bytes[3]) << 24;
}

float decodeFloat(const unsigned char* bytes);
void encodeShort(unsigned char* bytes, std::uint16_t value);
void encodeInt(unsigned char* bytes, std::uint32_t value);
void encodeFloat(unsigned char* bytes, float value);

/// Receives exactly one byte from `socket` into `*c`.
/// @return what `recv` returned: 1, 0 at the end of the stream, negative on error.
int sgetc(char* c, int socket);
