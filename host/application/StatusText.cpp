#include "host/application/StatusText.h"

#include <Errors.h>


const char*
StatusText(status_t status)
{
	switch (status) {
		case B_ENTRY_NOT_FOUND:
			return "there is no such file";
		case B_PERMISSION_DENIED:
			return "that is not permitted";
		case B_NOT_ALLOWED:
			return "it is read-only, or its owner and group could not be kept";
		case B_NOT_SUPPORTED:
			return "its attributes could not be kept";
		case B_IS_A_DIRECTORY:
			return "it is a folder";
		case B_NOT_A_DIRECTORY:
			return "a part of its path is not a folder";
		case B_DEVICE_FULL:
			return "the disk is full";
		case B_READ_ONLY_DEVICE:
			return "the disk can only be read";
		case B_NO_MEMORY:
			return "there is not enough memory";
		case B_NAME_IN_USE:
			return "type and number are taken";
		case B_BUSY:
			return "it is in use";
		case B_ERROR:
		case B_IO_ERROR:
		case B_BAD_DATA:
			return "it is damaged, or no resource file";
		default:
			return "it does not work";
	}
}
