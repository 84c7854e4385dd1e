#include "tools/zbtool/secrets.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/terminal.h"
#include "tools/zbtool/whole_file.h"

#include <zor_basis/crypto.h>
#include <zor_basis/files.h>

#include <algorithm>
#include <memory>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

/// The whole file but the end of its last line, which editors add.
bool readSecretFile(std::string const& path, SecretBlob& secret) {
    std::string reason;
    if (!readWhole(path, secret, reason)) return complain(path, reason);
    for (char end : {'\n', '\r'}) {
        if (secret.size() > 0 && secret.val()[secret.size() - 1] == end) secret.setSize(secret.size() - 1);
    }
    return secret.size() > 0 || complain(path, "contains no secret");
}

bool askForSecret(char const* prompt, SecretBlob& secret) {
    std::string line;
    bool const good = readHidden(prompt, line);
    secret.copy(line.size(), line.data());
    std::fill_n(static_cast<char volatile*>(line.data()), line.size(), '\0'); // never optimised away
    return (good && secret.size() > 0) || complain("secret", "none was typed");
}

/// \param twice  asks for it a second time: nobody could read what is encrypted with a slip of the finger
bool readSecret(CryptOptions const& options, bool twice, SecretBlob& secret) {
    if (!options.secretFile.empty()) return readSecretFile(options.secretFile, secret);
    SecretBlob again;
    if (!askForSecret("secret: ", secret)) return false;
    if (!twice) return true;
    return askForSecret("once more: ", again) && (again == secret || complain("secret", "the two differ"));
}

std::unique_ptr<CrKey> keyOf(SecretBlob const& secret) {
    std::unique_ptr<Crypt> const crypt(Crypt::make(""));
    CrHashPtr const hash(crypt.get());
    if (hash.ptr() == nullptr || !hash->hashData(secret.val(), secret.size())) return nullptr;
    return std::unique_ptr<CrKey>(crypt->deriveKey(hash));
}

/// Complains if the target is a file that is still needed, or any other file without being told to replace it.
bool mayWriteTarget(CryptOptions const& options) {
    if (!options.overwrite) return !FStat::exist(options.target.c_str()) || complain(options.target, "exists already");
    if (isSameFile(options.secretFile, options.target)) return complain(options.target, "is the secret's file");
    return !isSameFile(options.source, options.target) || complain(options.target, "is the file to read");
}

/// Reads the source, changes its bytes by a key of the secret, and writes the target.
template <class Change>
int transform(CryptOptions const& options, bool isEncrypting, Change change) {
    if (options.secretFile.empty() && !inputIsTerminal()) {
        complain("secret", "without a terminal to ask on it needs --secret-file");
        return MISUSED;
    }
    SecretBlob secret;
    SecretBlob bytes;
    std::string reason;
    if (!mayWriteTarget(options)) return FAILED;
    if (!readWhole(options.source, bytes, reason)) return exitCodeOf(complain(options.source, reason));
    if (!readSecret(options, isEncrypting, secret)) return FAILED;
    std::unique_ptr<CrKey> const key = keyOf(secret);
    if (key == nullptr || !key->isValid())
        return exitCodeOf(complain("secret", "the cryptographic service refuses it"));
    if (!change(*key, bytes))
        return exitCodeOf(complain(options.source, isEncrypting ? "too large" : "another secret, or damaged"));
    return exitCodeOf(writeWhole(options.target, bytes, reason) || complain(options.target, reason));
}

} // namespace

int encrypt(CryptOptions const& options) {
    return transform(options, true, [](CrKey& key, Blob& bytes) { return key.encrypt(bytes, bytes); });
}

int decrypt(CryptOptions const& options) {
    return transform(options, false, [](CrKey& key, Blob& bytes) { return key.decrypt(bytes, bytes); });
}

} // namespace zbtool
