// The messages that the windows of the resource editor exchange.
#pragma once

#include <SupportDefs.h>

// From menus and lists to the file window.
constexpr uint32 kNewFile = 'Nfil';
constexpr uint32 kOpenFile = 'Ofil'; // to the application: string "path", the asking window's file
constexpr uint32 kSave = 'Save';
constexpr uint32 kSaveAs = 'SvAs';
constexpr uint32 kRevert = 'Rvrt';
constexpr uint32 kUndoStep = 'Undo';
constexpr uint32 kRedoStep = 'Redo';
constexpr uint32 kOpenItem = 'Oitm';
constexpr uint32 kDeleteItem = 'Ditm';
constexpr uint32 kDuplicateItem = 'Dupl';
constexpr uint32 kItemAttributes = 'Attr';
constexpr uint32 kGenerateItem = 'Gitm'; // int32 "handler"; the fields of the generate-info

constexpr uint32 kImportItem = 'Iitm';
constexpr uint32 kExportItem = 'Eitm';

// From file panels to the file window, with what the user chose.
constexpr uint32 kImportChosen = 'Icho';
constexpr uint32 kExportChosen = 'Echo';

// From an attributes window to the file window: int32 "type", int32 "id", string "name".
constexpr uint32 kAttributesChosen = 'Acho';

// From the file window to an item window: finish what is being typed and write it into the item.
// Answered, when that is done, by kItemApplied.
constexpr uint32 kApplyItem = 'Aply';
constexpr uint32 kItemApplied = 'Apld';

// From an item window that goes.
constexpr uint32 kItemClosed = 'Clsd'; // pointer "window"

// From a file window to the application.
constexpr uint32 kFileWindowClosed = 'Fcls'; // pointer "window"
