#ifndef KIT_APP_WAITING_H
#define KIT_APP_WAITING_H

#include <chrono>
#include <condition_variable>
#include <mutex>

#include <SupportDefs.h>

namespace BPrivate {

// Waits on condition until ready() holds or timeout microseconds have passed
// (B_INFINITE_TIMEOUT, or anything past a few centuries, waits for good).
// Returns ready().
template<typename Ready>
bool WaitWithTimeout(std::condition_variable& condition,
	std::unique_lock<std::mutex>& lock, bigtime_t timeout, Ready ready)
{
	constexpr bigtime_t kForever = 1LL << 62;
	if (timeout >= kForever) {
		condition.wait(lock, ready);
		return true;
	}
	const auto deadline = std::chrono::steady_clock::now()
		+ std::chrono::microseconds(timeout > 0 ? timeout : 0);
	return condition.wait_until(lock, deadline, ready);
}

}

#endif
