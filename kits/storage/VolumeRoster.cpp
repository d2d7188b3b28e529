#include <VolumeRoster.h>

#include <stdio.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>

#include <algorithm>
#include <fstream>
#include <string>

#include <Volume.h>


BVolumeRoster::BVolumeRoster() = default;


BVolumeRoster::~BVolumeRoster() = default;


// Devices of the mount table without what the host marks as living in no storage; the root is
// always one.
static std::vector<dev_t>
list_devices()
{
	std::vector<dev_t> devices;
	struct stat root;
	if (stat("/", &root) == 0)
		devices.push_back(root.st_dev);

	std::ifstream table("/proc/self/mountinfo");
	for (std::string line; std::getline(table, line);) {
		unsigned high, low;
		if (sscanf(line.c_str(), "%*d %*d %u:%u", &high, &low) != 2 || high == 0)
			continue;
		const dev_t device = makedev(high, low);
		if (std::find(devices.begin(), devices.end(), device) == devices.end())
			devices.push_back(device);
	}
	return devices;
}


status_t
BVolumeRoster::GetNextVolume(BVolume* volume)
{
	if (volume == NULL)
		return B_BAD_VALUE;
	if (!fListed)
		fDevices = list_devices();
	fListed = true;
	while (fNext < fDevices.size()) {
		if (volume->SetTo(fDevices[fNext++]) == B_OK)
			return B_OK;
	}
	return B_BAD_VALUE;
}


void
BVolumeRoster::Rewind()
{
	fNext = 0;
	fListed = false;
}


status_t
BVolumeRoster::GetBootVolume(BVolume* volume)
{
	if (volume == NULL)
		return B_BAD_VALUE;
	struct stat root;
	if (stat("/", &root) < 0)
		return B_ERROR;
	return volume->SetTo(root.st_dev);
}
