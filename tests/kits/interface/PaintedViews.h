// Views for tests of painting, which say when and where they are drawn.
#pragma once

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Message.h>
#include <MessageFilter.h>
#include <Region.h>
#include <View.h>
#include <Window.h>

#include "support/TestWindow.h"


constexpr rgb_color kRed = { 255, 0, 0, 255 };
constexpr rgb_color kGreen = { 0, 255, 0, 255 };
constexpr rgb_color kBlue = { 0, 0, 255, 255 };
constexpr rgb_color kWhite = { 255, 255, 255, 255 };


class PaintView : public BView {
public:
	PaintView(BRect frame, rgb_color color, uint32 flags = 0, uint32 mode = B_FOLLOW_NONE) :
		BView(frame, "paint", mode, B_WILL_DRAW | flags)
	{
		SetViewColor(color);
	}

	void Draw(BRect updateRect) override
	{
		drawn++;
		update = updateRect;
		if (log != nullptr)
			log->push_back(this);
		if (onDraw)
			onDraw();
	}

	void DrawAfterChildren(BRect updateRect) override
	{
		drawnAfter++;
		if (onDrawAfter)
			onDrawAfter();
	}

	int drawn = 0;
	int drawnAfter = 0;
	BRect update;
	std::vector<BView*>* log = nullptr;
	std::function<void()> onDraw;
	std::function<void()> onDrawAfter;
};


class CountUpdates : public BMessageFilter {
public:
	CountUpdates(int* count) : BMessageFilter(_UPDATE_), fCount(count) {}
	filter_result Filter(BMessage* message, BHandler** target) override
	{
		(*fCount)++;
		targets.push_back(*target);
		return B_DISPATCH_MESSAGE;
	}
	std::vector<BHandler*> targets;

private:
	int* fCount;
};


inline std::string
rects(const BRegion& region)
{
	std::string text;
	for (int32 i = 0; i < region.CountRects(); i++) {
		const clipping_rect rect = region.RectAtInt(i);
		text += "(" + std::to_string(rect.left) + "," + std::to_string(rect.top) + ","
			+ std::to_string(rect.right) + "," + std::to_string(rect.bottom) + ")";
	}
	return text;
}
