#include <Translator.h>


BTranslator::BTranslator() = default;


BTranslator::~BTranslator() = default;


BTranslator*
BTranslator::Acquire()
{
	fReferences++;
	return this;
}


BTranslator*
BTranslator::Release()
{
	if (--fReferences > 0)
		return this;
	delete this;
	return NULL;
}


int32
BTranslator::ReferenceCount()
{
	return fReferences;
}


status_t
BTranslator::MakeConfigurationView(BMessage* ioExtension, BView** _view, BRect* _extent)
{
	return B_ERROR;
}


status_t
BTranslator::GetConfigurationMessage(BMessage* ioExtension)
{
	return B_ERROR;
}
