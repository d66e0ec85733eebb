#include "link/packet_parms.h"

void ZephSetUpPacketParms(ZephPacketParms& parms) noexcept {
    parms = {};
    for (std::int32_t sub = 0; sub <= 3; ++sub)
        parms[packetIndex(0, sub)] = kLightCommandParm;
}

bool hasStandardLayout(const ZephPacketParms& parms) noexcept {
    for (std::int32_t sub = 0; sub <= 3; ++sub) {
        if (parms[packetIndex(0, sub)] != kLightCommandParm) return false;
    }
    return true;
}
