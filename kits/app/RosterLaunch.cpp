// BRoster: finding and starting programs.

#include <Roster.h>

#include <spawn.h>
#include <sys/wait.h>

#include <string>
#include <thread>
#include <vector>

#include <Message.h>
#include <Mime.h>
#include <Node.h>
#include <NodeInfo.h>
#include <Path.h>

extern char** environ;

namespace {

// Starts a program, which is looked for in the folders of programs when its name has no slash.
status_t
Start(std::vector<std::string> words, team_id* _team)
{
	std::vector<char*> arguments;
	for (std::string& word : words)
		arguments.push_back(word.data());
	arguments.push_back(NULL);
	pid_t child = -1;
	if (posix_spawnp(&child, arguments[0], NULL, NULL, arguments.data(), environ) != 0)
		return B_LAUNCH_FAILED;
	if (_team != nullptr)
		*_team = child;
	std::thread([child] { waitpid(child, NULL, 0); }).detach();
	return B_OK;
}


status_t
StartFor(const BRoster& roster, const char* mimeType, const std::vector<std::string>& arguments,
	team_id* _team)
{
	entry_ref app;
	if (const status_t status = roster.FindApp(mimeType, &app); status != B_OK)
		return status;
	const BPath path(&app);
	if (path.InitCheck() != B_OK)
		return path.InitCheck();
	std::vector<std::string> words = { path.Path() };
	words.insert(words.end(), arguments.begin(), arguments.end());
	return Start(std::move(words), _team);
}


// Where the program of that signature is said to be, if it is there.
status_t
FindBySignature(const char* signature, entry_ref* _app)
{
	const BMimeType type(signature);
	entry_ref hint;
	if (type.GetAppHint(&hint) != B_OK || !BEntry(&hint).Exists())
		return B_LAUNCH_FAILED_APP_NOT_FOUND;
	*_app = hint;
	return B_OK;
}

} // namespace


status_t
BRoster::FindApp(const char* mimeType, entry_ref* _app) const
{
	const BMimeType type(mimeType);
	if (_app == nullptr || type.InitCheck() != B_OK)
		return B_BAD_VALUE;
	// A signature is a type, too.
	if (FindBySignature(mimeType, _app) == B_OK)
		return B_OK;

	char signature[B_MIME_TYPE_LENGTH + 1];
	if (type.GetPreferredApp(signature) == B_OK)
		return FindBySignature(signature, _app);
	BMimeType supertype;
	if (type.GetSupertype(&supertype) == B_OK && supertype.GetPreferredApp(signature) == B_OK)
		return FindBySignature(signature, _app);
	return B_LAUNCH_FAILED_NO_PREFERRED_APP;
}


status_t
BRoster::FindApp(entry_ref* ref, entry_ref* _app) const
{
	if (ref == nullptr || _app == nullptr)
		return B_BAD_VALUE;
	const BEntry entry(ref, true);
	BNode node(&entry);
	if (node.InitCheck() != B_OK)
		return node.InitCheck();

	const BNodeInfo info(&node);
	char name[B_MIME_TYPE_LENGTH + 1];
	if (info.GetPreferredApp(name) == B_OK)
		return FindBySignature(name, _app);
	if (info.GetType(name) == B_OK)
		return FindApp(name, _app);
	return B_LAUNCH_FAILED_NO_PREFERRED_APP;
}


status_t
BRoster::Launch(const char* mimeType, BMessage* initialMessage, team_id* _team) const
{
	std::vector<std::string> files;
	entry_ref ref;
	for (int32 i = 0; initialMessage != nullptr && initialMessage->FindRef("refs", i, &ref) == B_OK;
		 i++) {
		const BPath path(&ref);
		if (path.InitCheck() == B_OK)
			files.push_back(path.Path());
	}
	return StartFor(*this, mimeType, files, _team);
}


status_t
BRoster::Launch(const char* mimeType, int argc, char** arguments, team_id* _team) const
{
	if (argc < 0 || (argc > 0 && arguments == nullptr))
		return B_BAD_VALUE;
	return StartFor(*this, mimeType, std::vector<std::string>(arguments, arguments + argc), _team);
}


status_t
BRoster::Launch(const entry_ref* ref, const BMessage* initialMessage, team_id* _team) const
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const BPath path(ref);
	if (path.InitCheck() != B_OK)
		return path.InitCheck();
	return Start({ "xdg-open", path.Path() }, _team);
}
