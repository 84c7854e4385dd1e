/// \file
/// Text: views (`Str`, `WStr`, `WFxStr`), strings that keep short text inside the object (`BufStr`, `WBStr`), heap
/// strings of exact size (`HeapStr`), and buffers for calls that fill them (`Auto_ptr_CStr`). Bytes: `Blob`,
/// `SecretBlob`.
///
/// Narrow text is a sequence of bytes, wide text one of 16-bit code units. Views never copy; strings always do, and
/// copying a string copies its text. Nothing here is synchronised: an object belongs to one thread at a time.

#ifndef ZOR_BASIS_TEXT_H
#define ZOR_BASIS_TEXT_H

#include "zor_basis/store/blob.h"
#include "zor_basis/text/auto_ptr_cstr.h"
#include "zor_basis/text/buf_str.h"
#include "zor_basis/text/convert.h"
#include "zor_basis/text/heap_str.h"
#include "zor_basis/text/str.h"
#include "zor_basis/text/wb_str.h"
#include "zor_basis/text/wfx_str.h"
#include "zor_basis/text/wstr.h"

#endif
