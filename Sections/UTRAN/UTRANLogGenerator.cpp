#include "Sections/UTRAN/UTRANLogGenerator.h"

#include "Platform/SystemLog.h"
#include "Sections/UTRAN/UTRANClassIndex.h"

#include <algorithm>
#include <cctype>
#include <filesystem>

namespace spectrel {

namespace {

bool containsUTRAN(const std::string& path)
{
    constexpr std::string_view Wanted = "UTRAN";
    const auto same = [](char left, char right) { return std::toupper(static_cast<unsigned char>(left)) == right; };
    return std::search(path.begin(), path.end(), Wanted.begin(), Wanted.end(), same) != path.end();
}

} // namespace

UTRANLogGenerator::UTRANLogGenerator(const Context& context)
    : ZPHLogGenerator2(context)
{
    const auto paths = context.resources.propertyListPaths();
    const auto path = std::ranges::find_if(paths, containsUTRAN);
    if (path == paths.end())
        return;
    initWithPListName(std::filesystem::path(*path).stem().string(), std::make_shared<UTRANClassIndex>(context));
    SPECTREL_LOG(log(), Priority::Error, "Created UTRANLogGenerator object");
}

std::unique_ptr<UTRANLogGenerator> UTRANLogGenerator::generator(const Context& context)
{
    return std::make_unique<UTRANLogGenerator>(context);
}

std::string_view UTRANLogGenerator::className() const
{
    return "UTRANLogGenerator";
}

} // namespace spectrel
