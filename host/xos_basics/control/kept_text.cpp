#include "host/xos_basics/control/call_record.h"

#include <algorithm>
#include <cstring>
#include <new>

namespace host {

namespace {

constexpr std::size_t WORD = sizeof(std::uint64_t);
constexpr std::size_t FIRST_WORDS = 32;

TextBuffer* largerBuffer(TextBuffer* older, std::size_t used, std::size_t needed) {
    std::size_t const words = std::max({FIRST_WORDS, needed, older == nullptr ? 0 : 2 * older->words});
    auto* const buffer = new (std::nothrow) TextBuffer{older, words, nullptr};
    if (buffer == nullptr) return nullptr;
    buffer->data = new (std::nothrow) std::atomic<std::uint64_t>[words]();
    if (buffer->data == nullptr) {
        delete buffer;
        return nullptr;
    }
    for (std::size_t i = 0; older != nullptr && i < used; ++i) {
        buffer->data[i].store(older->data[i].load(std::memory_order_relaxed), std::memory_order_relaxed);
    }
    return buffer;
}

} // namespace

std::uint64_t keepText(CallSlot& slot, char const* text, std::size_t& used) {
    if (text == nullptr) return NULL_TEXT;
    std::size_t const bytes = std::strlen(text) + 1;
    std::size_t const start = used;
    std::size_t const end = start + (bytes + WORD - 1) / WORD;
    TextBuffer* buffer = slot.texts.load(std::memory_order_relaxed);
    if (buffer == nullptr || buffer->words < end) {
        buffer = largerBuffer(buffer, start, end);
        if (buffer == nullptr) return NULL_TEXT;
        slot.texts.store(buffer, std::memory_order_release);
    }
    for (std::size_t i = start, done = 0; i < end; ++i, done += WORD) {
        std::uint64_t word = 0;
        std::memcpy(&word, text + done, std::min(WORD, bytes - done));
        buffer->data[i].store(word, std::memory_order_release);
    }
    used = end;
    slot.textWords.store(end, std::memory_order_release);
    return start;
}

} // namespace host
