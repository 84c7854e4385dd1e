#include "zor_basis/system/process.h"

#include "basis/files/last_error.h"
#include "basis/platform/xos_basics.h"
#include "basis/system/process_impl.h"
#include "zor_basis/text/char_ops.h"

namespace ZOR_Basis {
namespace {

/// The parameter that answers with a function by which the platform layer finds functions.
constexpr std::uint32_t FUNCTION_RESOLVER = 0xFFFF8006;
using Resolver = void* (*)(void* module, char const* name);
static_assert(sizeof(Resolver) == 8);

void* resolve(char const* name) {
    Resolver resolver = nullptr;
    if (xos_BasicsParamLookup(FUNCTION_RESOLVER, &resolver, sizeof resolver) < 1) return nullptr;
    if (resolver != nullptr) return resolver(nullptr, name);
    refuse(Reason::NOT_FOUND);
    return nullptr;
}

} // namespace

bool Process::Create(char const* application, unsigned long* processId, char const* commandLine, int* exitCode) {
    // kept process-01: callers read the code whether they have waited or not.
    if (exitCode != nullptr) *exitCode = 0;
    if (application == nullptr && detail::isNothing(commandLine)) return refuse(Reason::BAD_ARGUMENT);
    return ProcessImpl::create(application, processId, commandLine, exitCode);
}

bool Process::Wait(unsigned long processId) { return ProcessImpl::wait(processId); }
bool Process::Terminate(unsigned long processId) { return ProcessImpl::terminate(processId); }

void* Process::loadLib(char const* name) { return xos_LibraryLoad(name); }

void* Process::ptrFunc(char const* name, void* module) {
    if (module == nullptr) return resolve(name);
    if (!detail::isNothing(name)) return ProcessImpl::findFunction(module, name);
    refuse(Reason::BAD_ARGUMENT);
    return nullptr;
}

} // namespace ZOR_Basis
