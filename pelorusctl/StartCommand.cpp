#include "LogGenerator/LogGenerator.h"
#include "pelorusctl/Commands.h"
#include "pelorusctl/Output.h"
#include "platform/PropertyList.h"
#include "platform/linux/LinuxPlatform.h"

namespace pelorus {

int startCommand(const StartCommandOptions& options)
{
    if (!options.resources.empty() && !isDirectory(options.resources))
        return fail(options.resources, "no directory");
    LinuxPlatform platform(options.resources);
    const auto generator = LogGenerator::generatorFromTechnology(platform, options.technology);
    const auto command = serializePropertyList(generator->getStartCommand());
    if (!command)
        return fail(options.technology, "has no start command");
    print({reinterpret_cast<const char*>(command->data()), command->size()});
    return finishOutput(kSuccess);
}

} // namespace pelorus
