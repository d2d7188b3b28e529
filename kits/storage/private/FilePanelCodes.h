// The messages inside a file panel's window.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {

constexpr uint32 kPanelName = 'PNam'; // the text of the field has changed
constexpr uint32 kPanelChoose = 'PCho';
constexpr uint32 kPanelCancel = 'PCan';
constexpr uint32 kPanelReplace = 'PRpl'; // int32 "which", string "path"
constexpr uint32 kPanelGo = 'PGo '; // string "path"
constexpr uint32 kPanelHidden = 'PHid';
constexpr uint32 kPanelRefresh = 'PRef';
constexpr uint32 kPanelAskFolder = 'PAsk';
constexpr uint32 kPanelMakeFolder = 'PMak'; // string "name"
constexpr uint32 kPanelAddFavorite = 'PAdd';
constexpr uint32 kPanelRemoveFavorite = 'PRem';

} // namespace BPrivate
