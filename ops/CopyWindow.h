#ifndef COPY_WINDOW_H
#define COPY_WINDOW_H

#include <atomic>

#include <Window.h>

class BDirectory;
class BStatusBar;
class BView;
struct entry_ref;

// A small progress window with one bar, and the engine whose long walks it
// shows. The window runs in its own thread; the walk runs in the caller's,
// reads the cancel flag that Escape sets between two items, and returns when
// it is done. The caller then locks and quits the window.
class CopyWindow : public BWindow {
public:
	CopyWindow(BRect frame);
	virtual ~CopyWindow();

	virtual void MessageReceived(BMessage* message);

	// Every entry below folder, at every depth, the folder itself not counted.
	int64 CountEntries(const entry_ref* folder);

	// Removes everything in the trash for good; 3 when cancelled, else 1.
	int32 EmptyTrash();
	int32 DeleteDirectory(const entry_ref* folder);
	void DeleteSubdirs(BDirectory* folder);
	void DeleteFiles(BDirectory* folder);

	std::atomic<bool> cancel;
	uint32 itemsRemaining;
	BView* backgroundView;
	BStatusBar* bar;

private:
	// Shows the item about to be handled and counts it down.
	void ShowItem(const char* name);
	// Adds delta to the bar, in the window's thread.
	void Advance(float delta);
};

#endif
