// Paths, file attributes and numbers as text.
#pragma once

#include "wintypes.h"

inline constexpr DWORD INVALID_FILE_ATTRIBUTES = 0xFFFFFFFF;
inline constexpr DWORD FILE_ATTRIBUTE_READONLY = 0x1;
inline constexpr DWORD FILE_ATTRIBUTE_DIRECTORY = 0x10;
inline constexpr DWORD FILE_ATTRIBUTE_DEVICE = 0x40; // or a pipe, or a socket
inline constexpr DWORD FILE_ATTRIBUTE_NORMAL = 0x80;

// Attributes of the file (links followed), or INVALID_FILE_ATTRIBUTES when it cannot be reached. A relative
// path is taken from the current folder.
TESSEL_API DWORD GetFileAttributesW(const wchar_t* path);

// The current folder. Answers its length; when it does not fit, the size needed with the terminator; 0 on
// failure.
TESSEL_API DWORD GetCurrentDirectory(DWORD capacity, wchar_t* buffer);

// Splits a path into drive ("C:"), folder (with its closing separator), name and extension (with its dot).
// Both "/" and "\\" separate. Sizes are in characters, the terminator included; a null buffer with size 0 is
// passed over. 0 on success. When a part does not fit, all four are emptied and ERANGE (34) is the answer;
// EINVAL (22) for a null path or a buffer and size that disagree.
TESSEL_API int _wsplitpath_s(const wchar_t* path, wchar_t* drive, std::size_t driveSize, wchar_t* folder,
                             std::size_t folderSize, wchar_t* name, std::size_t nameSize, wchar_t* extension,
                             std::size_t extensionSize);

// Writes the number in base 2 to 36 (10 with a sign, others as unsigned) and answers `buffer`, which must
// hold 33 characters.
TESSEL_API wchar_t* ms_itow(int value, wchar_t* buffer, int base);
