/// \file
/// `Blob` and `SecretBlob`, under the path that users include.

#ifndef ZOR_BASIS_TEXT_BLOB_H
#define ZOR_BASIS_TEXT_BLOB_H

#include "zor_basis/store/blob.h"

#endif
