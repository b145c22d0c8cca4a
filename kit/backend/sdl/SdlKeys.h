#ifndef KIT_BACKEND_SDL_KEYS_H
#define KIT_BACKEND_SDL_KEYS_H

#include <SDL.h>

#include <SupportDefs.h>

namespace BPrivate {

// The platform's raw key code of a key (its position on the keyboard), 0 for
// keys it has none for.
int32 RawKeyFor(SDL_Scancode scancode);

// The single "bytes" of keys that are not characters (Enter, arrows, F-keys
// as B_FUNCTION_KEY, ...); 0 for character keys.
char SpecialKeyByte(SDL_Keycode key);

// The platform's modifiers: Ctrl is B_CONTROL_KEY, Alt B_COMMAND_KEY and
// the logo key B_OPTION_KEY, each with its left or right flag.
uint32 ModifiersFor(Uint16 mod);

}

#endif
