// PanelFixture: a panel beside a ground that holds the edited views, used by mouse and keys.
#pragma once

#include <string>

#include <gtest/gtest.h>

#include <Button.h>
#include <CheckBox.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <TextControl.h>
#include <TextView.h>

#include "support/ControlUser.h"
#include "support/TestWindow.h"


// A view that counts how often it is drawn.
template<class Base> class Counting : public Base {
public:
	using Base::Base;

	void Draw(BRect updateRect) override
	{
		draws++;
		Base::Draw(updateRect);
	}

	int draws = 0;
};


template<class Panel> class PanelFixture : public testing::Test {
protected:
	PanelFixture() : window(BRect(20, 20, 819, 619))
	{
		panel = window.Add(new Panel);
		ground = window.Add(new BView(
			BRect(420, 0, 799, 599), "ground", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
	}

	// Adds a view to the ground and lets the panel use it.
	template<class View> View* Use(View* view)
	{
		window.Locked([&] {
			ground->AddChild(view);
			EXPECT_TRUE(panel->UseView(view));
		});
		return view;
	}

	// Lets the panel look again, as a new selection does.
	void Reload(BView* view)
	{
		window.Locked([&] { EXPECT_TRUE(panel->UseView(view)); });
	}

	void ExpectDeclined()
	{
		BView* plain = new BView(BRect(0, 0, 9, 9), NULL, B_FOLLOW_NONE, B_WILL_DRAW);
		window.Locked([&] {
			ground->AddChild(plain);
			EXPECT_FALSE(panel->UseView(plain));
			EXPECT_FALSE(panel->UseView(NULL));
		});
	}

	// The n-th control of a class with that label, at any depth.
	template<class Control> Control* Find(const std::string& label, int n = 0)
	{
		return ControlUser::Find<Control>(panel, label, n);
	}

	std::string Shown(const char* label, int n = 0) { return Find<BTextControl>(label, n)->Text(); }

	void TypeOver(const char* label, const char* text, int n = 0)
	{
		BTextControl* control = Find<BTextControl>(label, n);
		ASSERT_NE(nullptr, control);
		user.TypeOver(control, text);
	}

	void Press(const char* label) { window.driver.Click(Find<BButton>(label)); }
	void Tick(const char* label) { window.driver.Click(Find<BCheckBox>(label)); }
	bool IsTicked(const char* label) { return Find<BCheckBox>(label)->Value() != B_CONTROL_OFF; }

	void Choose(const char* fieldLabel, const char* item, int n = 0)
	{
		BMenuField* field = Find<BMenuField>(fieldLabel, n);
		ASSERT_NE(nullptr, field);
		user.Choose(field, item);
	}

	std::string Chosen(const char* fieldLabel, int n = 0)
	{
		BMenuItem* item = Find<BMenuField>(fieldLabel, n)->Menu()->FindMarked();
		return item != nullptr ? item->Label() : "";
	}

	TestWindow window;
	ControlUser user { window.driver };
	Panel* panel;
	BView* ground;
};
