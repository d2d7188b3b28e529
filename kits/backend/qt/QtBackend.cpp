#include "backend/Backend.h"

namespace BPrivate {


std::unique_ptr<Backend>
make_qt_backend()
{
	return nullptr;
}


} // namespace BPrivate
