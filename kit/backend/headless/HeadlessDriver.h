#ifndef KIT_BACKEND_HEADLESS_DRIVER_H
#define KIT_BACKEND_HEADLESS_DRIVER_H

#include <atomic>

#include "Display.h"

namespace BPrivate {

// Windows live only in memory: their frames are what the windows presented,
// and the one most recently shown or activated is the active one.
class HeadlessDriver : public DisplayDriver {
public:
	void CreateWindow(const std::shared_ptr<DisplayWindow>&) override {}
	void DestroyWindow(const std::shared_ptr<DisplayWindow>&) override {}
	void UpdateWindow(const std::shared_ptr<DisplayWindow>&) override {}
	void ActivateWindow(const std::shared_ptr<DisplayWindow>& window) override;
	void Present(const std::shared_ptr<DisplayWindow>&) override {}
	BRect ScreenFrame() override;

	void SetScreenSize(int32 width, int32 height);

private:
	std::atomic<int32> fWidth{1024};
	std::atomic<int32> fHeight{768};
};

}

#endif
