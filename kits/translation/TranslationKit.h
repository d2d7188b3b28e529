// Everything of the translation kit.
#pragma once

#include <BitmapStream.h>
#include <TranslationDefs.h>
#include <TranslationErrors.h>
#include <TranslationUtils.h>
#include <Translator.h>
#include <TranslatorFormats.h>
#include <TranslatorRoster.h>
