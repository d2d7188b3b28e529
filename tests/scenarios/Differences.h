// What differs between two resource files.
#pragma once

#include <map>
#include <string>


// The fields that differ, by their path, with their new value: as in
// { "ARCV:1/_views[0]/_views[2]/_frame", "[10,20,60,44]" }. A field or an item that only one of the
// files has is there with the value "gone" or "new"; other fields that differ in their type or
// place are there, too. The files are read by `arcv dump --json`.
std::map<std::string, std::string> DifferencesBetween(
	const std::string& before, const std::string& after);
