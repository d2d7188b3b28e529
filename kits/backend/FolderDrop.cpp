#include "backend/FolderDrop.h"

#include <algorithm>
#include <cctype>
#include <cstring>
#include <filesystem>
#include <system_error>

#include <sys/xattr.h>

namespace BPrivate {

namespace {

constexpr const char* kScheme = "file://";


int
HexDigit(char digit)
{
	if (digit >= '0' && digit <= '9')
		return digit - '0';
	const int lower = std::tolower(static_cast<unsigned char>(digit));
	return lower >= 'a' && lower <= 'f' ? lower - 'a' + 10 : -1;
}


std::string
Unescape(const std::string& text)
{
	std::string result;
	for (size_t i = 0; i < text.size(); i++) {
		if (text[i] == '%' && i + 2 < text.size() && HexDigit(text[i + 1]) >= 0
			&& HexDigit(text[i + 2]) >= 0) {
			result += static_cast<char>(HexDigit(text[i + 1]) * 16 + HexDigit(text[i + 2]));
			i += 2;
		} else {
			result += text[i];
		}
	}
	return result;
}


// As file managers do; the type of a file is such an attribute. Folders need not support any.
void
CopyUserAttributes(const std::string& from, const std::string& to)
{
	std::string names(std::max<ssize_t>(listxattr(from.c_str(), nullptr, 0), 0), '\0');
	names.resize(std::max<ssize_t>(listxattr(from.c_str(), names.data(), names.size()), 0));
	for (size_t start = 0; start < names.size(); start += std::strlen(&names[start]) + 1) {
		const char* name = &names[start];
		if (std::strncmp(name, "user.", 5) != 0)
			continue;
		std::string value(std::max<ssize_t>(getxattr(from.c_str(), name, nullptr, 0), 0), '\0');
		const ssize_t size = getxattr(from.c_str(), name, value.data(), value.size());
		if (size >= 0)
			setxattr(to.c_str(), name, value.data(), static_cast<size_t>(size), 0);
	}
}

} // namespace


std::vector<std::string>
paths_of_uri_list(const std::string& list)
{
	std::vector<std::string> paths;
	size_t start = 0;
	while (start < list.size()) {
		size_t end = list.find_first_of("\r\n", start);
		if (end == std::string::npos)
			end = list.size();
		const std::string line = list.substr(start, end - start);
		start = end + 1;
		if (line.rfind(kScheme, 0) != 0)
			continue;
		// A host may stand between the scheme and the path.
		const size_t path = line.find('/', std::char_traits<char>::length(kScheme));
		if (path != std::string::npos)
			paths.push_back(Unescape(line.substr(path)));
	}
	return paths;
}


std::string
uri_of_path(const std::string& path)
{
	static const char kDigits[] = "0123456789ABCDEF";

	std::string uri = kScheme;
	for (const char character : path) {
		const auto byte = static_cast<unsigned char>(character);
		if (std::isalnum(byte) || std::string("/-_.~").find(character) != std::string::npos) {
			uri += character;
		} else {
			uri += '%';
			uri += kDigits[byte >> 4];
			uri += kDigits[byte & 15];
		}
	}
	return uri;
}


bool
drop_on_folder(const DataOffer& offer, const std::string& folder)
{
	std::string list;
	if (!offer.get || !offer.get("text/uri-list", &list))
		return false;

	const std::vector<std::string> paths = paths_of_uri_list(list);
	for (const std::string& path : paths) {
		const std::filesystem::path target =
			std::filesystem::path(folder) / std::filesystem::path(path).filename();
		std::error_code error;
		if (!std::filesystem::copy_file(path, target, error) || error)
			return false;
		CopyUserAttributes(path, target);
	}
	return !paths.empty();
}


} // namespace BPrivate
