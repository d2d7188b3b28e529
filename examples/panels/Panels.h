// The designs of the example files. Each is the root of a view tree, which the caller owns.
#pragma once

#include <View.h>


constexpr rgb_color kPanelColor = { 216, 216, 216, 255 };

// A plain view in the colour of panels.
BView* MakePanel(BRect frame, const char* name, uint32 resizingMode = B_FOLLOW_ALL_SIDES);

BView* MakePreferences();
BView* MakeAboutPanel();
BView* MakeFindDialog();
BView* MakeColorPanel();
