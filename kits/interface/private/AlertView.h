// AlertView: the ground of an alert, with a darker stripe and the icon of its kind.
#pragma once

#include <Alert.h>
#include <View.h>

namespace BPrivate {


class _EXPORT AlertView : public BView {
public:
	AlertView(BRect frame, alert_type type);
	explicit AlertView(BMessage* archive);

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void Draw(BRect updateRect);

private:
	alert_type fType;
};

} // namespace BPrivate
