#include <MessageFilter.h>

#include <Looper.h>


BMessageFilter::BMessageFilter(uint32 command, filter_hook hook) :
	BMessageFilter(B_ANY_DELIVERY, B_ANY_SOURCE, command, hook)
{
}


BMessageFilter::BMessageFilter(message_delivery delivery, message_source source, filter_hook hook) :
	fFiltersAny(true), fWhat(0), fDelivery(delivery), fSource(source), fHook(hook)
{
}


BMessageFilter::BMessageFilter(
	message_delivery delivery, message_source source, uint32 command, filter_hook hook) :
	fFiltersAny(false),
	fWhat(command), fDelivery(delivery), fSource(source), fHook(hook)
{
}


BMessageFilter::BMessageFilter(const BMessageFilter& other) :
	fFiltersAny(other.fFiltersAny), fWhat(other.fWhat), fDelivery(other.fDelivery),
	fSource(other.fSource), fHook(other.fHook)
{
}


BMessageFilter::BMessageFilter(const BMessageFilter* other) : BMessageFilter(*other)
{
}


BMessageFilter::~BMessageFilter() = default;


BMessageFilter&
BMessageFilter::operator=(const BMessageFilter& other)
{
	// Where it is installed stays as it is.
	fFiltersAny = other.fFiltersAny;
	fWhat = other.fWhat;
	fDelivery = other.fDelivery;
	fSource = other.fSource;
	fHook = other.fHook;
	return *this;
}


filter_result
BMessageFilter::Filter(BMessage* message, BHandler** target)
{
	return B_DISPATCH_MESSAGE;
}


message_delivery
BMessageFilter::MessageDelivery() const
{
	return fDelivery;
}


message_source
BMessageFilter::MessageSource() const
{
	return fSource;
}


uint32
BMessageFilter::Command() const
{
	return fWhat;
}


bool
BMessageFilter::FiltersAnyCommand() const
{
	return fFiltersAny;
}


BLooper*
BMessageFilter::Looper() const
{
	return fOwner != nullptr ? fOwner->Looper() : nullptr;
}
