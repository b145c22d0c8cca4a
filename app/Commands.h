#ifndef VARNEL_COMMANDS_H
#define VARNEL_COMMANDS_H

#include <SupportDefs.h>

// Every command and notification code and every field name that passes
// between the window, the panes, the rename editor and the progress window.
// A field name always has the same type and meaning, whichever message
// carries it.

// Commands (menus, popup menus, keys).
constexpr uint32 GV_OPEN = 'open';
constexpr uint32 GV_ASK_RENAME = 'arnm';
constexpr uint32 GV_RENAMED = 'renm';
constexpr uint32 GV_DELETE = 'delt';
constexpr uint32 GV_NEW_FOLDER = 'nfld';
constexpr uint32 GV_EMPTY_TRASH = 'empt';
constexpr uint32 GV_HELP = 'help';
constexpr uint32 GV_FOLDER_OPEN = 'fdop';

// Drag and drop.
constexpr uint32 GV_COPY = 'copy';
constexpr uint32 GV_MOVE = 'move';
constexpr uint32 GV_LINK = 'link';

// Folder shown, change notification or bare refresh.
constexpr uint32 GV_REFRESH = 'rfsh';

// Fields.
constexpr const char* GV_PARENT_REF = "parent ref";           // entry_ref
constexpr const char* GV_READ_ONLY = "readonly";              // bool
constexpr const char* GV_VOLUME = "volume";                   // bool
constexpr const char* GV_DEVICE = "device";                   // int32
constexpr const char* GV_EVENT = "event";                     // int32, several
constexpr const char* GV_NEW_REF = "new ref";                 // entry_ref
constexpr const char* GV_NEW = "new";                         // bool, presence
constexpr const char* GV_DELETED_REF = "deleted ref";         // entry_ref
constexpr const char* GV_DELETED_PARENT_REF = "deleted parent ref"; // entry_ref
constexpr const char* GV_OLD_REF = "old ref";                 // entry_ref
constexpr const char* GV_RENAMED_REF = "renamed ref";         // entry_ref
constexpr const char* GV_TREE_INDEX = "tree index";           // int32
constexpr const char* GV_FILES_INDEX = "files index";         // int32
constexpr const char* GV_SOURCE_REF = "source ref";           // entry_ref
constexpr const char* GV_SOURCE_PATH = "source path";         // flattened BPath
constexpr const char* GV_FOLDER = "folder";                   // bool
constexpr const char* GV_IS_LINK = "link";                    // bool, presence
constexpr const char* GV_DESTINATION_REF = "destination ref"; // entry_ref
constexpr const char* GV_NAME = "name";                       // string
constexpr const char* GV_POSITION = "position";               // float

// Fields of the platform's own messages that the program reads.
constexpr const char* GV_MODIFIERS = "modifiers";
constexpr const char* GV_BUTTONS = "buttons";
constexpr const char* GV_CLICKS = "clicks";
constexpr const char* GV_KEY = "key";
constexpr const char* GV_OPCODE = "opcode";
constexpr const char* GV_NEW_DEVICE = "new device";

// The status a pane reports for the window's menus.
enum {
	GV_STATUS_NO_FOCUS = -1,
	GV_STATUS_ORDINARY = 0,
	GV_STATUS_READ_ONLY = 1,
	GV_STATUS_DESKTOP_OR_NONE = 2,
	GV_STATUS_PROTECTED = 3,
	GV_STATUS_VOLUME = 4
};

#endif
