#ifndef KIT_STORAGE_DIRECTORY_REGISTRY_H
#define KIT_STORAGE_DIRECTORY_REGISTRY_H

#include <atomic>
#include <map>
#include <memory>
#include <mutex>
#include <shared_mutex>
#include <string>

#include <SupportDefs.h>

namespace BPrivate {

struct NodeData;

// Where the folders the kit has seen lie, by (volume id, node), so that an
// entry_ref can be turned back into a path. A path is checked with lstat
// each time it is used; the kit's own renames and moves of folders carry
// the paths of the folders below along.
class DirectoryRegistry {
public:
	static DirectoryRegistry& Default();

	// Held shared while a folder's path is looked up and registered, and
	// exclusively while the kit moves a folder and then its registered
	// paths, so that no one records or resolves a path a move has just
	// left behind.
	std::shared_mutex& MoveLock() { return fMoveLock; }

	// systemDevice is the folder's own st_dev, checked on use. A folder
	// registered by a BDirectory open on it also keeps that BDirectory's node
	// (not owning it) until another opens it; a registration without a node
	// keeps the one known.
	void Register(dev_t device, ino_t node, dev_t systemDevice,
		const std::string& path,
		const std::shared_ptr<NodeData>& open = nullptr);
	// B_ENTRY_NOT_FOUND when the folder is unknown or no longer there.
	// Takes the move lock itself.
	status_t Resolve(dev_t device, ino_t node, std::string* path);
	// How many moves of folders the kit has made: a path found before a
	// change of the count may be one a move left behind.
	uint64 Moves() const { return fMoves.load(); }
	// The node of a BDirectory open on the folder right now, or NULL.
	std::shared_ptr<NodeData> OpenFolder(dev_t device, ino_t node);
	// A folder (and so everything below it) now lies at to.
	void Moved(const std::string& from, const std::string& to);
	void Removed(const std::string& path);

private:
	struct Location {
		std::string path;
		dev_t systemDevice;
		std::weak_ptr<NodeData> open;
	};

	std::shared_mutex fMoveLock;
	std::atomic<uint64> fMoves = 0;
	std::mutex fLock;
	std::map<std::pair<dev_t, ino_t>, Location> fFolders;
};

}

#endif
