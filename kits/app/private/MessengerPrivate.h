// MessengerPrivate: the three numbers of an address.
#pragma once

#include <Messenger.h>

namespace BPrivate {


class MessengerPrivate {
public:
	static int32 Port(const BMessenger& messenger) { return messenger.fPort; }
	static int32 Token(const BMessenger& messenger) { return messenger.fToken; }
	static team_id Team(const BMessenger& messenger) { return messenger.fTeam; }

	static BMessenger Make(int32 port, int32 token, team_id team)
	{
		BMessenger messenger;
		messenger.fPort = port;
		messenger.fToken = token;
		messenger.fTeam = team;
		return messenger;
	}
};


} // namespace BPrivate
