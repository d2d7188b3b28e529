// The Support Kit in one include.
#pragma once

#include <Archivable.h>
#include <Autolock.h>
#include <BeBuild.h>
#include <Beep.h>
#include <BlockCache.h>
#include <ByteOrder.h>
#include <ClassInfo.h>
#include <DataIO.h>
#include <Debug.h>
#include <Errors.h>
#include <Flattenable.h>
#include <List.h>
#include <Locker.h>
#include <StopWatch.h>
#include <String.h>
#include <SupportDefs.h>
#include <TypeConstants.h>
#include <UTF8.h>
