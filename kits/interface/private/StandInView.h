// StandInView: takes the place of an archived view whose class is not available.
#pragma once

#include <string>

#include <View.h>

namespace BPrivate {


// Shows the class's name in its frame. Whatever its archive holds, children included, is written
// back, with only what was changed by setters. Its class counts as that of the archive.
class StandInView final : public BView {
public:
	explicit StandInView(BMessage* archive);

	void Draw(BRect updateRect) override;
	// Of the archive; empty if it says none.
	const char* ArchivedClass() const { return fClass.c_str(); }

private:
	std::string fClass;
};


} // namespace BPrivate
