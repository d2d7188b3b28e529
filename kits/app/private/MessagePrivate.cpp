#include "app/private/MessagePrivate.h"

#include "app/private/LookUps.h"
#include "app/private/MessageData.h"
#include "app/private/WriteBack.h"

namespace BPrivate {


DeliveryState::~DeliveryState()
{
}


void
MessagePrivate::SetDelivery(std::unique_ptr<DeliveryState> state)
{
	delete fMessage->fDelivery;
	fMessage->fDelivery = state.release();
}


void
MessagePrivate::SetData(MessageData* data)
{
	if (data != nullptr)
		data->Acquire();
	if (fMessage->fData != nullptr)
		fMessage->fData->Release();
	fMessage->fData = data;
}


void
MessagePrivate::SetWriteBack(std::unique_ptr<WriteBack> writeBack)
{
	delete fMessage->fWriteBack;
	fMessage->fWriteBack = writeBack.release();
}


void
MessagePrivate::SetLookUps(LookUps* lookUps)
{
	if (lookUps != nullptr)
		lookUps->Acquire();
	if (fMessage->fLookUps != nullptr)
		fMessage->fLookUps->Release();
	fMessage->fLookUps = lookUps;
}


} // namespace BPrivate
