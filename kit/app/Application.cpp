#include <Application.h>

#include <climits>
#include <cstring>
#include <string>
#include <vector>

#include <strings.h>
#include <unistd.h>

#include <AppDefs.h>
#include <Entry.h>
#include <Message.h>
#include <Roster.h>
#include <Window.h>

#include "AppMainLoop.h"
#include "ErrnoStatus.h"
#include "LooperAccess.h"
#include "LooperPort.h"

BApplication* be_app = NULL;
BMessenger be_app_messenger;

namespace BPrivate {

struct ApplicationData {
	std::string signature;
	status_t status = B_OK;
};

namespace {

// "application/<subtype>", the subtype made of MIME token characters.
bool IsValidSignature(const char* signature)
{
	static const char kPrefix[] = "application/";
	const size_t prefixLength = sizeof(kPrefix) - 1;
	if (signature == nullptr || std::strlen(signature) >= B_MIME_TYPE_LENGTH
		|| strncasecmp(signature, kPrefix, prefixLength) != 0)
		return false;
	const char* subtype = signature + prefixLength;
	if (*subtype == '\0')
		return false;
	for (const char* c = subtype; *c != '\0'; c++) {
		const unsigned char byte = static_cast<unsigned char>(*c);
		if (byte <= ' ' || byte >= 0x7f || std::strchr("()<>@,;:\\\"/[]?=", byte) != nullptr)
			return false;
	}
	return true;
}

}

}

using BPrivate::LooperAccess;

BApplication::BApplication(const char* signature)
	: BApplication(signature, NULL)
{
}

BApplication::BApplication(const char* signature, status_t* error)
	: BLooper("application"),
	fAppData(std::make_unique<BPrivate::ApplicationData>())
{
	BPrivate::ApplicationData& data = *fAppData;
	data.signature = signature != nullptr ? signature : "";
	if (!BPrivate::IsValidSignature(signature))
		data.status = B_BAD_VALUE;
	// There is one application object at a time.
	if (be_app != nullptr)
		data.status = B_NOT_ALLOWED;
	else {
		be_app = this;
		be_app_messenger = BMessenger(this);
	}
	LooperAccess::Port(this)->SetWakesMainLoop();
	PostMessage(B_READY_TO_RUN);
	if (error != nullptr)
		*error = data.status;
}

BApplication::~BApplication()
{
	if (be_app == this) {
		be_app = NULL;
		be_app_messenger = BMessenger();
	}
}

status_t BApplication::InitCheck() const
{
	return fAppData->status;
}

thread_id BApplication::Run()
{
	if (InitCheck() != B_OK)
		return InitCheck();
	const std::shared_ptr<BPrivate::LooperPort>& port = LooperAccess::Port(this);
	port->SetThread(find_thread(NULL));
	port->ReleaseConstructionLock();
	port->SetRunning(true);
	if (std::shared_ptr<BPrivate::MainLoop> loop = BPrivate::ActiveMainLoop()) {
		loop->Run(this);
	} else {
		while (BPrivate::DispatchApplicationMessages(this, B_INFINITE_TIMEOUT)) {
		}
	}
	// Whatever arrives from now on is refused.
	port->Close();
	return port->Thread();
}

void BApplication::Quit()
{
	// Run returns after the current message; the object itself lives on,
	// as it belongs to main.
	LooperAccess::Port(this)->RequestStop();
}

bool BApplication::QuitRequested()
{
	// Every window is asked, the newest first; one that refuses keeps the
	// application running.
	for (int32 index = CountWindows() - 1; index >= 0; index--) {
		BLooper* window = WindowAt(index);
		if (window == nullptr || !window->Lock())
			continue;
		if (!window->QuitRequested()) {
			window->Unlock();
			return false;
		}
		window->Quit();
	}
	return true;
}

void BApplication::ReadyToRun()
{
}

void BApplication::ArgvReceived(int32 /*argc*/, char** /*argv*/)
{
}

void BApplication::AppActivated(bool /*active*/)
{
}

void BApplication::RefsReceived(BMessage* /*message*/)
{
}

void BApplication::AboutRequested()
{
}

void BApplication::Pulse()
{
}

void BApplication::MessageReceived(BMessage* message)
{
	BLooper::MessageReceived(message);
}

void BApplication::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (handler != this) {
		BLooper::DispatchMessage(message, handler);
		return;
	}
	switch (message->what) {
		case B_READY_TO_RUN:
			ReadyToRun();
			break;
		case B_ABOUT_REQUESTED:
			AboutRequested();
			break;
		case B_ARGV_RECEIVED: {
			std::vector<std::string> arguments;
			const char* argument;
			for (int32 i = 0; message->FindString("argv", i, &argument) == B_OK; i++)
				arguments.emplace_back(argument);
			std::vector<char*> argv;
			for (std::string& each : arguments)
				argv.push_back(each.data());
			argv.push_back(nullptr);
			ArgvReceived(static_cast<int32>(arguments.size()), argv.data());
			break;
		}
		case B_REFS_RECEIVED:
			RefsReceived(message);
			break;
		case B_APP_ACTIVATED:
			AppActivated(message->GetBool("active", false));
			break;
		case B_PULSE:
			Pulse();
			break;
		default:
			BLooper::DispatchMessage(message, handler);
			break;
	}
}

status_t BApplication::GetAppInfo(app_info* info) const
{
	if (info == nullptr)
		return B_BAD_VALUE;
	info->thread = Thread();
	info->team = Team();
	info->port = -1;
	info->flags = 0;
	std::strncpy(info->signature, Signature(), B_MIME_TYPE_LENGTH - 1);
	info->signature[B_MIME_TYPE_LENGTH - 1] = '\0';

	char path[PATH_MAX];
	const ssize_t length = readlink("/proc/self/exe", path, sizeof(path) - 1);
	if (length < 0)
		return BPrivate::StatusFromErrno();
	path[length] = '\0';
	return get_ref_for_path(path, &info->ref);
}

const char* BApplication::Signature() const
{
	return fAppData->signature.c_str();
}
