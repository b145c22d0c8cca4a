#include <NodeInfo.h>

#include <climits>
#include <cstring>
#include <string>

#include <unistd.h>

#include <Node.h>
#include <SymLink.h>
#include <TypeConstants.h>

#include "ErrnoStatus.h"
#include "MimeDatabase.h"
#include "TypeIcons.h"

using namespace BPrivate;

namespace {

// GIO's types for the special files, which are never read.
const char* SpecialFileType(mode_t mode)
{
	if (S_ISCHR(mode))
		return "inode/chardevice";
	if (S_ISBLK(mode))
		return "inode/blockdevice";
	if (S_ISFIFO(mode))
		return "inode/fifo";
	if (S_ISSOCK(mode))
		return "inode/socket";
	return nullptr;
}

// A node knows no name of its own; its descriptor does.
std::string GuessFileType(BNode& node)
{
	int fd = node.Dup();
	if (fd < 0)
		return GuessMimeType("", [](void*, size_t) { return (ssize_t)-1; });

	char path[PATH_MAX];
	std::string link = "/proc/self/fd/" + std::to_string(fd);
	ssize_t length = readlink(link.c_str(), path, sizeof(path) - 1);
	path[length > 0 ? length : 0] = '\0';
	const char* slash = strrchr(path, '/');
	std::string type = GuessMimeType(slash != nullptr ? slash + 1 : path,
		[fd](void* buffer, size_t size) {
			ssize_t read = pread(fd, buffer, size, 0);
			return read >= 0 ? read : (ssize_t)StatusFromErrno();
		});
	close(fd);
	return type;
}

status_t NodeType(BNode& node, std::string* type)
{
	// Stored with or without a closing NUL; anything that is not a valid
	// type is ignored.
	char stored[B_MIME_TYPE_LENGTH];
	ssize_t length = node.ReadAttr(kTypeAttribute, B_RAW_TYPE, 0, stored,
		sizeof(stored));
	if (length > 0 && length < (ssize_t)sizeof(stored)) {
		stored[length] = '\0';
		if (BMimeType::IsValid(stored)) {
			*type = stored;
			return B_OK;
		}
	}

	struct stat st;
	status_t status = node.GetStat(&st);
	if (status != B_OK)
		return status;
	if (S_ISDIR(st.st_mode))
		*type = kDirectoryMimeType;
	else if (S_ISLNK(st.st_mode))
		*type = kSymLinkMimeType;
	else if (const char* special = SpecialFileType(st.st_mode))
		*type = special;
	else
		*type = GuessFileType(node);
	return B_OK;
}

}

BNodeInfo::BNodeInfo()
	: fNode(NULL), fCStatus(B_NO_INIT)
{
}

BNodeInfo::BNodeInfo(BNode* node)
	: BNodeInfo()
{
	SetTo(node);
}

BNodeInfo::~BNodeInfo()
{
}

status_t BNodeInfo::SetTo(BNode* node)
{
	fNode = NULL;
	if (node == NULL || node->InitCheck() != B_OK)
		return fCStatus = B_BAD_VALUE;
	fNode = node;
	return fCStatus = B_OK;
}

status_t BNodeInfo::InitCheck() const
{
	return fCStatus;
}

status_t BNodeInfo::GetType(char* type) const
{
	if (fCStatus != B_OK)
		return B_NO_INIT;
	if (type == NULL)
		return B_BAD_VALUE;
	std::string found;
	status_t status = NodeType(*fNode, &found);
	if (status == B_OK)
		CopyString(found, type, B_MIME_TYPE_LENGTH);
	return status;
}

status_t BNodeInfo::SetType(const char* type)
{
	if (fCStatus != B_OK)
		return B_NO_INIT;
	if (type == NULL) {
		status_t status = fNode->RemoveAttr(kTypeAttribute);
		return status == B_ENTRY_NOT_FOUND ? B_OK : status;
	}
	if (!BMimeType::IsValid(type))
		return B_BAD_VALUE;

	// Without a NUL, as other programs write it.
	size_t length = strlen(type);
	ssize_t written = fNode->WriteAttr(kTypeAttribute, B_RAW_TYPE, 0, type,
		length);
	if (written < 0)
		return written;
	return written == (ssize_t)length ? B_OK : B_IO_ERROR;
}

status_t BNodeInfo::GetIcon(BBitmap* icon, icon_size which) const
{
	if (fCStatus != B_OK)
		return B_NO_INIT;
	status_t status = CheckIconBitmap(icon, which);
	if (status != B_OK)
		return status;

	const char* name = StandardIconName(which);
	type_code code = which == B_LARGE_ICON ? B_LARGE_ICON_TYPE
		: B_MINI_ICON_TYPE;
	IconPixels pixels{which, std::vector<uint8>(which * which)};
	attr_info info;
	if (fNode->GetAttrInfo(name, &info) != B_OK || info.type != code
		|| info.size != (off_t)pixels.indices.size()
		|| fNode->ReadAttr(name, code, 0, pixels.indices.data(),
			pixels.indices.size()) != info.size)
		return B_ENTRY_NOT_FOUND;
	CopyIconToBitmap(pixels, icon);
	return B_OK;
}

status_t BNodeInfo::GetTrackerIcon(BBitmap* icon, icon_size which) const
{
	if (fCStatus != B_OK)
		return B_NO_INIT;
	status_t status = CheckIconBitmap(icon, which);
	if (status != B_OK || GetIcon(icon, which) == B_OK)
		return status;

	std::string type;
	IconRef pixels;
	if (NodeType(*fNode, &type) == B_OK)
		pixels = IconForType(NormalizedMimeType(type.c_str()), which);
	if (pixels == nullptr) {
		pixels = GetBuiltinIcon(fNode->IsDirectory() ? BuiltinIcon::kFolder
			: fNode->IsSymLink() ? BuiltinIcon::kLink : BuiltinIcon::kFile,
			which);
	}
	CopyIconToBitmap(*pixels, icon);
	return B_OK;
}

status_t BNodeInfo::GetTrackerIcon(const entry_ref* ref, BBitmap* icon,
	icon_size which)
{
	if (ref == NULL)
		return B_BAD_VALUE;
	BNode node(ref);
	if (node.InitCheck() == B_OK)
		return BNodeInfo(&node).GetTrackerIcon(icon, which);

	// A link whose target is gone still shows as a link.
	BSymLink link(ref);
	if (link.InitCheck() != B_OK)
		return node.InitCheck();
	return BNodeInfo(&link).GetTrackerIcon(icon, which);
}
