#pragma once

#include "tests/embedded/store/InMemFixture.h"

namespace NORVZEL20 {

/// Device { Id key } > Disk { Size } > SolidState { Wear }, Device > Fan { Speed }, and Room { Name key }.
class TDevicesFixture : public TInMemFixture {
  protected:
    TDevicesFixture()
    {
        device = Declare("Device", nullptr, {{"Id", TType::kString, {"Key"}}});
        disk = Declare("Disk", device, {{"Size", TType::kUint64, {}}});
        solidState = Declare("SolidState", disk, {{"Wear", TType::kUint8, {}}});
        fan = Declare("Fan", device, {{"Speed", TType::kUint32, {}}});
        room = Declare("Room", nullptr, {{"Name", TType::kString, {"Key"}}});
    }

    boost::shared_ptr<ICIMClass> Root() { return ns->GetClass("<root>", none); }

    TClassPointer device, disk, solidState, fan, room;
};

}  // namespace NORVZEL20
