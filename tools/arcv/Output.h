// What arcv writes: results, complaints, files.
#pragma once

#include <sys/types.h>

#include <string>
#include <string_view>

#include <SupportDefs.h>

namespace Arcv {

// To standard output.
void Print(std::string_view text);
// False when not all of it could be written, which is said then.
bool FinishOutput();

// "arcv: FILE: text" on standard error; with an offset in the file unless that is negative.
void Complain(const std::string& file, const std::string& text, off_t offset = -1);

// A status in words: "there is no such file".
std::string StatusText(status_t status);

// Whether a file is there already.
bool Exists(const std::string& path);

// Writes a whole file beside its place and renames it, or writes to standard output for "-".
// False after a complaint.
bool WriteWholeFile(const std::string& path, std::string_view bytes);

// A new file for a copy of another with the same bytes; false after a complaint.
bool CopyFile(const std::string& from, const std::string& to);

} // namespace Arcv
