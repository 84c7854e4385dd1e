#include "tests/faults/scenario.h"

#include <zor_basis/containers.h>
#include <zor_basis/crypto.h>
#include <zor_basis/flat.h>
#include <zor_basis/memory.h>
#include <zor_basis/text.h>

#include <cstdlib>
#include <cstring>
#include <memory>

using namespace ZOR_Basis;

namespace {

std::string const LONG(300, 'x');

bool growsInside(Place const&) {
    BufStr<15> text("short");
    text.add(LONG.c_str());
    text.insert(2, LONG.c_str());
    text.replace(0, 5, "y");
    return text.size() == 5 + 600 - 4;
}

bool growsWide(Place const&) {
    WBStr text;
    for (int i = 0; i < 300; ++i) text += static_cast<WChar>('a' + i % 26);
    WBStr const copy(text);
    return copy == text && copy.size() == 300;
}

bool holdsOnTheHeap(Place const&) {
    HeapStr text(LONG.c_str());
    HeapStr const copy(text);
    text = "other";
    return copy.size() == LONG.size() && text.size() == 5;
}

bool converts(Place const&) {
    std::string const text = LONG + "\xC3\xA4\xE2\x82\xAC" + LONG;
    WBStr wide;
    BufStr<255> back;
    return Convert::Utf8ToWide(text.c_str(), wide) && Convert::WideToUtf8(wide, back) && back == Str(text);
}

bool convertsLocally(Place const&) {
    WBStr wide;
    BufStr<255> back;
    BufStr<255> oem;
    return Convert::LocalToWide(LONG.c_str(), wide) && Convert::WideToLocal(wide, back) && back == Str(LONG) &&
           Convert::EncodeMB(Convert::ENC_UTF8, LONG.c_str(), Convert::ENC_OEM, oem) && oem == Str(LONG) &&
           Convert::LocalToUtf8(LONG.c_str(), back) && Convert::Utf8ToLocal(LONG.c_str(), back);
}

bool ownsACText(Place const&) {
    Auto_ptr_CStr text(LONG);
    return std::strcmp(text.c_str(), LONG.c_str()) == 0;
}

bool duplicates(Place const&) {
    char* const text = ZB_StrDup(LONG.c_str());
    bool const isWhole = text != nullptr && LONG == text;
    std::free(text);
    return isWhole;
}

bool keepsPointers(Place const&) {
    PtrArray<char const> array(1);
    for (int i = 0; i < 300; ++i) array.insertBack(&LONG[0]);
    PtrArray<char const> const copy(array);
    return copy.size() == 300;
}

bool listsAndSorts(Place const&) {
    SngList<int> list;
    for (int i = 0; i < 20; ++i) list.insertFront(i);
    SngList<int> const copy(list);
    list.sort(true);
    return list.size() == 20 && copy.size() == 20 && list.first()->value == 0;
}

bool hashesTexts(Place const&) {
    HashedStr<BufStr<255>> const text(LONG.c_str(), LONG.size());
    HashedStr<BufStr<255>> const copy(text);
    return copy == text;
}

bool allocatesSmallBlocks(Place const&) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(64, 16, 64, 8));
    if (static_cast<MemMgr*>(manager) == nullptr) return false;
    for (int i = 0; i < 200; ++i) {
        if (manager->alloc() == nullptr) return false;
    }
    return true;
}

bool allocatesOnAStack(Place const&) {
    MemMgrPtr const manager(MemMgr::makeStack(256, nullptr));
    if (static_cast<MemMgr*>(manager) == nullptr) return false;
    for (int i = 0; i < 50; ++i) {
        if (manager->alloc(40) == nullptr) return false;
    }
    return true;
}

bool copiesBlobs(Place const&) {
    Blob blob(LONG.size(), LONG.c_str());
    blob.add(5, "abcde");
    SecretBlob secret;
    secret = SecretBlob();
    secret.copy(LONG.size(), LONG.c_str());
    Blob const copy(blob);
    return copy == blob && copy.size() == LONG.size() + 5 && secret.size() == LONG.size();
}

bool encrypts(Place const&) {
    std::unique_ptr<Crypt> const crypt(Crypt::make(""));
    if (crypt == nullptr) return false;
    std::unique_ptr<CrHash> const hash(crypt->createHash());
    if (hash == nullptr || !hash->hashData("secret", 6)) return false;
    std::unique_ptr<CrKey> const key(crypt->deriveKey(hash.get()));
    if (key == nullptr) return false;
    Blob const message(LONG.size(), LONG.c_str());
    Blob encrypted;
    Blob back;
    return key->encrypt(message, encrypted) && key->decrypt(encrypted, back) && back == message;
}

bool exportsAKey(Place const&) {
    std::unique_ptr<Crypt> const crypt(Crypt::make(""));
    if (crypt == nullptr) return false;
    CrHashPtr const hash(crypt.get());
    Blob key;
    return hash.ptr() != nullptr && hash->hashData("secret", 6) && hash->exportKey(key) && key.size() == 28;
}

} // namespace

Scenarios textScenarios() {
    return {
        {"BufStr::add, insert, replace", prepareNothing, growsInside},
        {"WBStr", prepareNothing, growsWide},
        {"HeapStr", prepareNothing, holdsOnTheHeap},
        {"Convert, UTF-8", prepareNothing, converts},
        {"Convert, local", prepareNothing, convertsLocally},
        {"Auto_ptr_CStr", prepareNothing, ownsACText},
        {"ZB_StrDup", prepareNothing, duplicates},
        {"PtrArray", prepareNothing, keepsPointers},
        {"SngList", prepareNothing, listsAndSorts},
        {"HashedStr", prepareNothing, hashesTexts},
        {"MemMgr::makeSmlBlk", prepareNothing, allocatesSmallBlocks},
        {"MemMgr::makeStack", prepareNothing, allocatesOnAStack},
        {"Blob", prepareNothing, copiesBlobs},
        {"CrKey::encrypt, decrypt", prepareNothing, encrypts},
        {"CrHash::exportKey", prepareNothing, exportsAKey},
    };
}
