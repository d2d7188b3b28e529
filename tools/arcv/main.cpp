#include "tools/arcv/Command.h"

int
main(int argc, char** argv)
{
	return Arcv::RunArcv(argc, argv);
}
