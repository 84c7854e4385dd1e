// Values of the library in all their states, for printers_test.py to look at in the debugger.

#include <zor_basis/containers.h>
#include <zor_basis/files.h>
#include <zor_basis/store/dict.h>
#include <zor_basis/sync.h>
#include <zor_basis/text.h>
#include <zor_basis/timers.h>

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

using namespace ZOR_Basis;

namespace {

std::string const LONG_TEXT(20, 'x');

struct Texts {
    Str view{"seen"};
    Str emptyView;
    Str cutView{"cut off", 3};
    Str nothing{nullptr, 0};
    Str badView{nullptr, 7};
    BufStr<15> inlineText{"tray \"1\""};
    BufStr<15> heapText{LONG_TEXT.c_str()};
    BufStr<15> emptyText;
    BufStr<255> largeText{"page"};
    BufStr<15> manyBytes;
    HeapStr stored{"stored"};
    HeapStr storedNothing;
    FPath path{"/scsi0/tmp"};
    HashedStr<BufStr<255>> hashed{"key"};
    Auto_ptr_CStr copied{"copied"};

    Texts() {
        for (int i = 0; i < 1000; ++i) manyBytes += 'm';
    }
};

struct WideTexts {
    WStr view{ZB_W("wide")};
    WBStr inlineText{ZB_W("p\u00E4ge")};
    WBStr heapText;
    WBStr emptyText;
    WcPath path{ZB_W("c:/tmp")};
    WFxStr fixed;

    WideTexts() {
        for (int i = 0; i < 300; ++i) heapText += WChar(i % 2 == 0 ? 'v' : 'w');
        fixed.set(ZB_W("fixed length"), 5);
    }
};

struct Bytes {
    Blob none;
    Blob some{5, "a\"\0\xFFz"};
    Blob cleared{5, "abcde"};
    SecretBlob secret;

    Bytes() {
        cleared.clear();
        secret.copy(6, "hushed");
    }
};

struct Sequences {
    SngList<int> list;
    SngList<int> movedFrom;
    SngList<int> emptyList;
    Dict<Blob, Blob> dict{"no such file"};
    Dict<Blob, Blob> emptyDict;
    PtrArray<int> pointers{2};
    PtrArray<int> noPointers{2};
    int value = 7;

    Sequences() {
        list.insertBack(1);
        list.insertBack(2);
        SngList<int> moved;
        moved.insertBack(3);
        movedFrom = std::move(moved);
        moved = std::move(movedFrom);
        dict.set(Blob(4, "tray"), Blob(1, "2"));
        pointers.insertBack(&value);
        pointers.insertBack(nullptr);
        pointers.insertBack(&value);
    }
};

struct Timers {
    PileTimer fresh{"fresh", false};
    PileTimer used{"used", false};
    PileTimer running{"running", false};
    PileTimerMT shared{"shared", false};
    BaseTimer idle;
    BaseTimer held{true, true};

    Timers() {
        for (int i = 0; i < 2; ++i) {
            used.start(false);
            used.stop();
        }
        running.start(false);
    }
};

bool succeed(void*) { return true; }
bool fail(void*) { return false; }

int used(void const*) { return 0; }

int shown(Texts& texts, WideTexts& wide, Bytes& bytes, Sequences& sequences, Timers& timers, MTQ_Dat& good,
          MTQ_Dat& bad, MTQ_Dat& waiting) {
    return used(&texts) + used(&wide) + used(&bytes) + used(&sequences) + used(&timers) + used(&good) + used(&bad) +
           used(&waiting);
}

} // namespace

int main() {
    Texts texts;
    WideTexts wide;
    Bytes bytes;
    Sequences sequences;
    Timers timers;
    std::unique_ptr<MultiTaskQueue> const queue(MultiTaskQueue::New(MultiTaskQueue::Continue, 0));
    bool const areAdded =
        queue->add(succeed, &texts, false, true, false) && queue->add(fail, nullptr, false, true, false);
    queue->wait();
    queue->add(succeed, nullptr, false, false, false);
    MTQ_Dat* const good = queue->first();
    MTQ_Dat* const bad = queue->next();
    MTQ_Dat* const waiting = queue->next();
    if (!areAdded || good == nullptr || bad == nullptr || waiting == nullptr) return 1;
    return shown(texts, wide, bytes, sequences, timers, *good, *bad, *waiting);
}
