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
    enum class HandOver { Nothing, Done, Busy };

    ReceiveQueue() { filling_.reserve(kBlockBytes); }

    // The reader's side: appends bytes to its own block, which nobody else sees.
    void put(std::string_view bytes) { filling_.append(bytes); }
    // Hands the block over, if it holds bytes. Busy, with the block kept, where the other side is just taking: the
    // reader must not wait for it, since the system may have put that thread aside in the middle of it.
    HandOver tryHandOver();
    // The same, waiting for the other side; for the end.
    void handOver();

    // The other side: replaces text by the first block that waits, empty when none does. text's own storage is kept
    // for reuse.
    void take(std::string& text);

private:
    static constexpr std::size_t kBlockBytes = 1 << 20;
    static constexpr std::size_t kMostSpare = 4;

    void handOverLocked();

    std::string filling_;  // the reader's
    std::mutex guard_;     // of what follows
    std::deque<std::string> waiting_;
    std::vector<std::string> spare_;
};
