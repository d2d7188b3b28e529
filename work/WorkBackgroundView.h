// WorkBackgroundView: the checkered ground that holds the edited tree.
#pragma once

#include <View.h>


class WorkBackgroundView : public BView {
public:
	WorkBackgroundView(BRect frame, const char* name, uint32 resizingMode, uint32 flags);

	void Draw(BRect updateRect) override;
};
