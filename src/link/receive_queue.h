// The handover between the thread that reads the socket and the thread that works off the stream: the one guarded
// point of the link. Bytes lie in blocks that are passed over whole and come back to be filled again, so that neither
// side waits while the other copies, however much has piled up.
#pragma once

#include <cstddef>
#include <deque>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

class ReceiveQueue {
public:
    // The reader's side: appends bytes behind what waits.
    void put(std::string_view bytes);

    // The other side: replaces text by the first block that waits, empty when none does. text's own storage is kept
    // for reuse.
    void take(std::string& text);

private:
    static constexpr std::size_t kBlockBytes = 1 << 20;
    static constexpr std::size_t kMostSpare = 4;

    std::mutex guard_;
    std::deque<std::string> waiting_;
    std::vector<std::string> spare_;
};
