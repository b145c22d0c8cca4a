#ifndef _ROSTER_H
#define _ROSTER_H

#include <Entry.h>
#include <Messenger.h>

class BMessage;

struct app_info {
	app_info();
	~app_info();

	thread_id thread;
	team_id team;
	port_id port;
	uint32 flags;
	entry_ref ref;
	char signature[B_MIME_TYPE_LENGTH];
};

// On Linux, Launch opens a file or folder with the user's default application
// for its type (through GIO): B_ENTRY_NOT_FOUND when the ref names nothing,
// B_LAUNCH_FAILED when no application handles it or it cannot start. Other
// programs do not read BMessages, so initialMessage is not delivered, and
// GIO does not say which process it started: appTeam is set to -1.
//
// Each running program is its own team (its process id), and the only one
// known here is this program: TeamFor, IsRunning, GetAppInfo and
// GetRunningAppInfo answer for this program's signature, executable or team
// and fail (B_ERROR, B_BAD_TEAM_ID) for any other. ActivateApp of this
// program's team sends the application B_APP_ACTIVATED ("active" true).
class BRoster {
public:
	BRoster();
	~BRoster();

	status_t Launch(const entry_ref* ref, const BMessage* initialMessage = NULL,
		team_id* appTeam = NULL) const;
	status_t Launch(const char* mimeType, BMessage* initialMessage = NULL,
		team_id* appTeam = NULL) const;
	// For the platform's URL types ("application/x-vnd.Be.URL.mailto", ...)
	// each argument is a URL handed to the desktop's handler of its scheme;
	// for any other type the arguments are files for the type's default
	// application. Nothing passes through a shell.
	status_t Launch(const char* mimeType, int argc, const char* const* args,
		team_id* appTeam = NULL) const;

	team_id TeamFor(const char* signature) const;
	team_id TeamFor(const entry_ref* ref) const;
	bool IsRunning(const char* signature) const;
	bool IsRunning(const entry_ref* ref) const;
	status_t ActivateApp(team_id team) const;
	status_t GetAppInfo(const char* signature, app_info* info) const;
	status_t GetRunningAppInfo(team_id team, app_info* info) const;
};

extern const BRoster* be_roster;

#endif
