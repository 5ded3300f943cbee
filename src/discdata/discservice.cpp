#include "discdata/discservice.h"

void DiscService::send(const DiscRecord & /*disc*/, const TableOfContents & /*toc*/,
                       LongWork & /*work*/)
{
    throw Error(errNotAccepted, name(), errorText("xServiceTakesNone", {}));
}
