// ListHeader: the names of the columns above the list of a file window.
#pragma once

#include <View.h>


class ListHeader : public BView {
public:
	explicit ListHeader(BRect frame);

	void Draw(BRect updateRect) override;
};
