#include "discdata/discservice.h"

std::vector<DiscRecord> DiscService::recording(const QString & /*id*/, LongWork & /*work*/)
{
    return {};
}

void DiscService::send(const DiscRecord & /*disc*/, const TableOfContents & /*toc*/,
                       LongWork & /*work*/)
{
    throw Error(errNotAccepted, name(), errorText("xServiceTakesNone", {}));
}
