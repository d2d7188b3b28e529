// The forms of flattened messages, by the names that the command line has for them.
#pragma once

#include <map>
#include <string>

#include <MessageForm.h>

namespace Arcv {

inline const std::map<std::string, message_form>&
WritableForms()
{
	static const std::map<std::string, message_form>& forms =
		*new std::map<std::string, message_form> { { "r5", B_R5_FORM },
			{ "r5-wide", B_R5_WIDE_FORM }, { "haiku", B_HAIKU_FORM } };
	return forms;
}


inline const char*
FormName(message_form form)
{
	switch (form) {
		case B_R5_FORM:
			return "r5";
		case B_R5_WIDE_FORM:
			return "r5-wide";
		case B_HAIKU_FORM:
			return "haiku";
		case B_DANO_FORM:
			return "dano";
		default:
			return "raw";
	}
}

} // namespace Arcv
