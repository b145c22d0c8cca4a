#include <Roster.h>

#include <cstdlib>
#include <cstring>
#include <mutex>
#include <string>

#include <fcntl.h>
#include <strings.h>
#include <unistd.h>

#include <gio/gio.h>

#include <AppDefs.h>
#include <Application.h>
#include <Message.h>
#include <Path.h>

#include "GioLock.h"
#include "RosterPrivate.h"

namespace {

struct LaunchHook {
	std::mutex mutex;
	std::function<status_t(const char*)> hook;
};

LaunchHook& Hook()
{
	static LaunchHook hook;
	return hook;
}

status_t AppendLine(const char* file, const char* line)
{
	const int fd = open(file, O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0644);
	if (fd < 0)
		return B_LAUNCH_FAILED;
	// One write, so that lines of concurrent launches do not mix.
	const std::string text = std::string(line) + '\n';
	const ssize_t written = write(fd, text.data(), text.size());
	close(fd);
	if (written != static_cast<ssize_t>(text.size()))
		return B_LAUNCH_FAILED;
	return B_OK;
}

// The test hook or the launch log stand in for the real launcher when set.
bool LaunchSubstituted(const char* what, status_t* result)
{
	std::function<status_t(const char*)> hook;
	{
		std::lock_guard<std::mutex> lock(Hook().mutex);
		hook = Hook().hook;
	}
	if (hook) {
		*result = hook(what);
		return true;
	}
	const char* log = std::getenv("VARNEL_LAUNCH_LOG");
	if (log != nullptr && *log != '\0') {
		*result = AppendLine(log, what);
		return true;
	}
	return false;
}

struct GObjectUnref {
	void operator()(gpointer object) const { g_object_unref(object); }
};

template<typename T>
using GObjectRef = std::unique_ptr<T, GObjectUnref>;

status_t StartApp(GAppInfo* app, GList* files)
{
	if (app == nullptr)
		return B_LAUNCH_FAILED;
	GError* error = nullptr;
	const gboolean started = g_app_info_launch(app, files, nullptr, &error);
	g_clear_error(&error);
	if (!started)
		return B_LAUNCH_FAILED;
	return B_OK;
}

status_t OpenWithDefaultApp(const char* path)
{
	std::lock_guard<std::mutex> lock(BPrivate::GioLock());
	GObjectRef<GFile> file(g_file_new_for_path(path));
	GError* error = nullptr;
	GObjectRef<GAppInfo> app(g_file_query_default_handler(file.get(), nullptr, &error));
	g_clear_error(&error);
	GList files = {file.get(), nullptr, nullptr};
	return StartApp(app.get(), &files);
}

status_t OpenUris(int count, const char* const* uris)
{
	std::lock_guard<std::mutex> lock(BPrivate::GioLock());
	for (int i = 0; i < count; i++) {
		GError* error = nullptr;
		const gboolean started = g_app_info_launch_default_for_uri(uris[i], nullptr,
			&error);
		g_clear_error(&error);
		if (!started)
			return B_LAUNCH_FAILED;
	}
	return B_OK;
}

status_t StartDefaultAppWith(const char* mimeType, int count, const char* const* args)
{
	std::lock_guard<std::mutex> lock(BPrivate::GioLock());
	GObjectRef<GAppInfo> app(g_app_info_get_default_for_type(mimeType, FALSE));
	GList* files = nullptr;
	for (int i = count - 1; i >= 0; i--)
		files = g_list_prepend(files, g_file_new_for_commandline_arg(args[i]));
	const status_t result = StartApp(app.get(), files);
	g_list_free_full(files, g_object_unref);
	return result;
}

status_t StartDefaultAppFor(const char* mimeType)
{
	std::lock_guard<std::mutex> lock(BPrivate::GioLock());
	GObjectRef<GAppInfo> app(g_app_info_get_default_for_type(mimeType, FALSE));
	return StartApp(app.get(), nullptr);
}

bool IsThisProgram(const char* signature)
{
	return signature != nullptr && be_app != nullptr
		&& strcasecmp(signature, be_app->Signature()) == 0;
}

void SetUnknownTeam(team_id* team)
{
	// GIO does not tell which process it started.
	if (team != nullptr)
		*team = -1;
}

const BRoster sRoster;

}

const BRoster* be_roster = &sRoster;

namespace BPrivate {

void SetLaunchHook(std::function<status_t(const char* path)> hook)
{
	std::lock_guard<std::mutex> lock(Hook().mutex);
	Hook().hook = std::move(hook);
}

}

app_info::app_info()
	: thread(-1), team(-1), port(-1), flags(0)
{
	signature[0] = '\0';
}

app_info::~app_info() = default;

BRoster::BRoster() = default;

BRoster::~BRoster() = default;

status_t BRoster::Launch(const entry_ref* ref, const BMessage* /*initialMessage*/,
	team_id* appTeam) const
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	BEntry entry(ref);
	BPath path;
	if (entry.InitCheck() != B_OK || !entry.Exists() || entry.GetPath(&path) != B_OK)
		return B_ENTRY_NOT_FOUND;
	SetUnknownTeam(appTeam);
	status_t result;
	if (LaunchSubstituted(path.Path(), &result))
		return result;
	return OpenWithDefaultApp(path.Path());
}

status_t BRoster::Launch(const char* mimeType, BMessage* /*initialMessage*/,
	team_id* appTeam) const
{
	if (mimeType == nullptr)
		return B_BAD_VALUE;
	SetUnknownTeam(appTeam);
	status_t result;
	if (LaunchSubstituted(mimeType, &result))
		return result;
	return StartDefaultAppFor(mimeType);
}

status_t BRoster::Launch(const char* mimeType, int argc, const char* const* args,
	team_id* appTeam) const
{
	if (mimeType == nullptr || argc < 0 || (argc > 0 && args == nullptr))
		return B_BAD_VALUE;
	SetUnknownTeam(appTeam);
	std::string what(mimeType);
	for (int i = 0; i < argc; i++)
		what += std::string(" ") + args[i];
	status_t result;
	if (LaunchSubstituted(what.c_str(), &result))
		return result;
	static const char kUrlPrefix[] = "application/x-vnd.Be.URL.";
	if (strncasecmp(mimeType, kUrlPrefix, sizeof(kUrlPrefix) - 1) == 0)
		return OpenUris(argc, args);
	return StartDefaultAppWith(mimeType, argc, args);
}

team_id BRoster::TeamFor(const char* signature) const
{
	return IsThisProgram(signature) ? be_app->Team() : B_ERROR;
}

team_id BRoster::TeamFor(const entry_ref* ref) const
{
	app_info info;
	if (ref == nullptr || be_app == nullptr || be_app->GetAppInfo(&info) != B_OK
		|| info.ref != *ref)
		return B_ERROR;
	return info.team;
}

bool BRoster::IsRunning(const char* signature) const
{
	return TeamFor(signature) >= 0;
}

bool BRoster::IsRunning(const entry_ref* ref) const
{
	return TeamFor(ref) >= 0;
}

status_t BRoster::ActivateApp(team_id team) const
{
	if (be_app == nullptr || team != be_app->Team())
		return B_BAD_TEAM_ID;
	BMessage activated(B_APP_ACTIVATED);
	activated.AddBool("active", true);
	return be_app->PostMessage(&activated);
}

status_t BRoster::GetAppInfo(const char* signature, app_info* info) const
{
	if (info == nullptr)
		return B_BAD_VALUE;
	if (!IsThisProgram(signature))
		return B_ERROR;
	return be_app->GetAppInfo(info);
}

status_t BRoster::GetRunningAppInfo(team_id team, app_info* info) const
{
	if (info == nullptr)
		return B_BAD_VALUE;
	if (be_app == nullptr || team != be_app->Team())
		return B_BAD_TEAM_ID;
	return be_app->GetAppInfo(info);
}
