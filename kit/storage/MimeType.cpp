#include <MimeType.h>

#include <cstring>
#include <strings.h>

#include "MimeDatabase.h"
#include "TypeIcons.h"

using namespace BPrivate;

BMimeType::BMimeType()
	: fCStatus(B_NO_INIT)
{
	fType[0] = '\0';
}

BMimeType::BMimeType(const char* mimeType)
	: BMimeType()
{
	SetTo(mimeType);
}

BMimeType::~BMimeType()
{
}

status_t BMimeType::SetTo(const char* mimeType)
{
	Unset();
	if (!IsValid(mimeType))
		return fCStatus = B_BAD_VALUE;
	strcpy(fType, mimeType);
	return fCStatus = B_OK;
}

void BMimeType::Unset()
{
	fType[0] = '\0';
	fCStatus = B_NO_INIT;
}

status_t BMimeType::InitCheck() const
{
	return fCStatus;
}

const char* BMimeType::Type() const
{
	return fCStatus == B_OK ? fType : NULL;
}

bool BMimeType::IsValid() const
{
	return fCStatus == B_OK;
}

bool BMimeType::operator==(const BMimeType& type) const
{
	return *this == type.Type();
}

bool BMimeType::operator==(const char* type) const
{
	if (Type() == NULL || type == NULL)
		return Type() == type;
	return strcasecmp(fType, type) == 0;
}

status_t BMimeType::GetIcon(BBitmap* icon, icon_size size) const
{
	if (fCStatus != B_OK)
		return B_NO_INIT;
	status_t status = CheckIconBitmap(icon, size);
	if (status != B_OK)
		return status;
	IconRef pixels = IconForType(NormalizedMimeType(fType), size);
	if (pixels == nullptr)
		return B_ENTRY_NOT_FOUND;
	CopyIconToBitmap(*pixels, icon);
	return B_OK;
}

status_t BMimeType::GetPreferredApp(char* signature, app_verb) const
{
	if (fCStatus != B_OK)
		return B_NO_INIT;
	if (signature == NULL)
		return B_BAD_VALUE;
	std::string app;
	status_t status = GetMimePreferredApp(NormalizedMimeType(fType), &app);
	if (status == B_OK)
		CopyString(app, signature, B_MIME_TYPE_LENGTH);
	return status;
}

status_t BMimeType::GetShortDescription(char* description) const
{
	return _GetDescription(description, true);
}

status_t BMimeType::GetLongDescription(char* description) const
{
	return _GetDescription(description, false);
}

bool BMimeType::IsValid(const char* mimeType)
{
	if (mimeType == NULL)
		return false;
	size_t length = strlen(mimeType);
	if (length == 0 || length >= B_MIME_TYPE_LENGTH)
		return false;

	// A supertype, or supertype/subtype; both made of RFC 2045 token
	// characters.
	const char* slash = strchr(mimeType, '/');
	if (slash == mimeType
		|| (slash != NULL && (slash[1] == '\0' || strchr(slash + 1, '/'))))
		return false;
	for (const char* c = mimeType; *c != '\0'; c++) {
		unsigned char byte = *c;
		if (byte == '/')
			continue;
		if (byte <= ' ' || byte >= 0x7f || strchr("()<>@,;:\\\"[]?=", byte))
			return false;
	}
	return true;
}

status_t BMimeType::_GetDescription(char* description, bool shortForm) const
{
	if (fCStatus != B_OK)
		return B_NO_INIT;
	if (description == NULL)
		return B_BAD_VALUE;
	std::string text;
	status_t status = GetMimeDescription(NormalizedMimeType(fType), shortForm,
		&text);
	if (status == B_OK)
		CopyString(text, description, B_MIME_TYPE_LENGTH);
	return status;
}
