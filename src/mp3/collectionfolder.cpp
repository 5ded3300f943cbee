#include "mp3/collectionfolder.h"

#include "platform/work/longwork.h"
#include "services/fileutilities.h"
#include "services/messages.h"

#include <QDir>
#include <future>
#include <thread>

namespace
{

constexpr std::chrono::milliseconds moment(100); // no more than a person takes for at once

}

QString pathInFolder(const QString &folder, const QString &fileName)
{
    return systemPath(folder + QDir::separator() + fileName);
}

std::optional<bool> isFolderThere(Form &screen, const QString &folder)
{
    std::promise<bool> asked;
    const std::shared_future<bool> answer = asked.get_future();
    std::thread([asked = std::move(asked), folder]() mutable {
        asked.set_value(DirExists(folder));
    }).detach();
    if (answer.wait_for(moment) == std::future_status::ready)
        return answer.get();
    std::optional<bool> isThere;
    LongWork work(screen, GetMessage("xLookingForFolder"));
    const auto look = [answer](qsizetype, const std::stop_token &) { return answer.get(); };
    work.eachOf<bool>(1, look, [&](qsizetype, bool &&found) { isThere = found; });
    return isThere;
}
