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
// for its type (through GIO). Each running program is its own team: TeamFor
// knows only this program, and ActivateApp can only bring this program's
// windows forward.
class BRoster {
public:
	BRoster();
	~BRoster();

	status_t Launch(const entry_ref* ref, const BMessage* initialMessage = NULL,
		team_id* appTeam = NULL) const;
	status_t Launch(const char* mimeType, BMessage* initialMessage = NULL,
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
