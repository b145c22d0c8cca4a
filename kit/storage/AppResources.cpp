#include <map>
#include <mutex>
#include <string>
#include <utility>

#include "AppResources.h"

namespace BPrivate {

const char* const kShortInfoResource = "BEOS:APP_VERSION:short_info";
const char* const kLongInfoResource = "BEOS:APP_VERSION:long_info";

namespace {

struct Registry {
	std::mutex lock;
	std::map<std::string, std::pair<const void*, size_t>> resources;
};

// Made on first use: registration runs during static initialisation.
Registry& TheRegistry()
{
	static Registry sRegistry;
	return sRegistry;
}

}

void RegisterAppResource(const char* name, const void* data, size_t size)
{
	Registry& registry = TheRegistry();
	std::lock_guard<std::mutex> lock(registry.lock);
	if (data == nullptr)
		registry.resources.erase(name);
	else
		registry.resources[name] = {data, size};
}

bool FindAppResource(const char* name, const void** data, size_t* size)
{
	Registry& registry = TheRegistry();
	std::lock_guard<std::mutex> lock(registry.lock);
	auto found = registry.resources.find(name);
	if (found == registry.resources.end())
		return false;
	*data = found->second.first;
	*size = found->second.second;
	return true;
}

}
