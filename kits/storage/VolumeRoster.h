// BVolumeRoster: the file systems that can be seen.
#pragma once

#include <sys/types.h>

#include <vector>

#include <SupportDefs.h>

class BVolume;

// Lists what was mounted when the walk began. Pseudo file systems, which hold no files of a user,
// are left out.
class BVolumeRoster {
public:
	BVolumeRoster();
	virtual ~BVolumeRoster();
	BVolumeRoster(const BVolumeRoster&) = delete;
	BVolumeRoster& operator=(const BVolumeRoster&) = delete;

	// B_BAD_VALUE at the end.
	status_t GetNextVolume(BVolume* volume);
	void Rewind();
	// That of the root directory.
	status_t GetBootVolume(BVolume* volume);

private:
	std::vector<dev_t> fDevices;
	size_t fNext = 0;
	bool fListed = false;
};
