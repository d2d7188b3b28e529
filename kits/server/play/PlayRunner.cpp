#include "server/play/PlayRunner.h"
namespace BPrivate {
PlayRunner::PlayRunner(DesktopThread& desktop, const char* path) : fDesktop(desktop), fPath(path)
{
}
PlayRunner::~PlayRunner()
{
}
void
PlayRunner::Start()
{
}
void
PlayRunner::ProgramEnds()
{
}
void
PlayRunner::Stop()
{
}
} // namespace BPrivate
