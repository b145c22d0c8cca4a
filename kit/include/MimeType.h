#ifndef _MIME_TYPE_H
#define _MIME_TYPE_H

#include <Mime.h>
#include <StorageDefs.h>

class BBitmap;

enum app_verb {
	B_OPEN = 0
};

// A MIME type string ("supertype/subtype" or a supertype alone). Types
// compare without regard to case. Descriptions, icons and preferred
// applications come from the system's shared MIME database (through GIO) and
// the icon theme; the platform's own folder, volume and link types are known
// to the kit itself.
class BMimeType {
public:
	BMimeType();
	BMimeType(const char* mimeType);
	virtual ~BMimeType();

	status_t SetTo(const char* mimeType);
	void Unset();
	status_t InitCheck() const;

	// NULL while not initialised.
	const char* Type() const;
	bool IsValid() const;

	bool operator==(const BMimeType& type) const;
	bool operator==(const char* type) const;

	// icon must be a B_CMAP8 bitmap of exactly the asked size.
	status_t GetIcon(BBitmap* icon, icon_size size) const;
	// The desktop file id of the user's default application for the type.
	status_t GetPreferredApp(char* signature, app_verb verb = B_OPEN) const;
	// description must hold B_MIME_TYPE_LENGTH bytes; it is left untouched
	// when the database does not describe the type.
	status_t GetShortDescription(char* description) const;
	status_t GetLongDescription(char* description) const;

	static bool IsValid(const char* mimeType);

private:
	status_t _GetDescription(char* description, bool shortForm) const;

	char fType[B_MIME_TYPE_LENGTH];
	status_t fCStatus;
};

#endif
