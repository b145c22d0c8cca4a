#ifndef KIT_PRIVATE_APP_RESOURCES_H
#define KIT_PRIVATE_APP_RESOURCES_H

#include <cstddef>

namespace BPrivate {

// Resources of the running program, by name: files that
// varnel_embed_resources (cmake/EmbedResources.cmake) compiles into the
// executable register themselves here before main() runs. Icons are PNGs
// named as the platform names icons (StandardIconName in TypeIcons.h); the
// version texts are plain text.
extern const char* const kShortInfoResource;	// "BEOS:APP_VERSION:short_info"
extern const char* const kLongInfoResource;		// "BEOS:APP_VERSION:long_info"

// data must outlive its registration; null data removes the resource.
void RegisterAppResource(const char* name, const void* data, size_t size);

// False when the program has no resource of that name.
bool FindAppResource(const char* name, const void** data, size_t* size);

}

#endif
