// ApplicationLink: what the desktop tells the application, on its way there.
#pragma once

#include "server/Desktop.h"

class BApplication;

namespace BPrivate {


class ApplicationLink final : public ApplicationClient {
public:
	explicit ApplicationLink(BApplication* application) : fApplication(application) {}

	void PostToApplication(BMessage* message) override;

private:
	BApplication* fApplication; // borrowed; outlives the desktop
};


} // namespace BPrivate
