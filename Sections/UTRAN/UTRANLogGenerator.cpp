#include "Sections/UTRAN/UTRANLogGenerator.h"

#include "Platform/Resources.h"
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

UTRANLogGenerator::UTRANLogGenerator()
{
    const auto paths = Resources::installed().propertyListPaths();
    const auto path = std::ranges::find_if(paths, containsUTRAN);
    if (path == paths.end())
        return;
    initWithPListName(std::filesystem::path(*path).stem().string(), std::make_shared<UTRANClassIndex>());
    SPECTREL_LOG(Priority::Error, "Created UTRANLogGenerator object");
}

std::unique_ptr<UTRANLogGenerator> UTRANLogGenerator::generator()
{
    return std::make_unique<UTRANLogGenerator>();
}

std::string_view UTRANLogGenerator::className() const
{
    return "UTRANLogGenerator";
}

} // namespace spectrel
