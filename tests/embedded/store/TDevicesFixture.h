#pragma once

#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {

/// Device { Id key } > Disk { Size } > SolidState { Wear }, Device > Fan { Speed }, and Room { Name key }.
class TDevicesFixture : public TInMemFixture {
  protected:
    TDevicesFixture()
    {
        fDevice = Declare("Device", nullptr, {{"Id", TType::kString, {"Key"}}});
        fDisk = Declare("Disk", fDevice, {{"Size", TType::kUint64, {}}});
        fSolidState = Declare("SolidState", fDisk, {{"Wear", TType::kUint8, {}}});
        fFan = Declare("Fan", fDevice, {{"Speed", TType::kUint32, {}}});
        fRoom = Declare("Room", nullptr, {{"Name", TType::kString, {"Key"}}});
    }

    boost::shared_ptr<ICIMClass> Root() { return fNamespace->GetClass("<root>", kNoContext); }

    TClassPointer fDevice, fDisk, fSolidState, fFan, fRoom;
};

}  // namespace NORVZEL20
