#pragma once

#include <string>
#include <string_view>

/// SHA-256 of `bytes`, 64 hexadecimal digits in lower case.
std::string Sha256(std::string_view bytes);

/// HMAC-SHA256 of `bytes` with `key`, in the same form. Without the key nobody can try names against it.
std::string KeyedDigest(std::string_view key, std::string_view bytes);

/// 64 hexadecimal digits that nobody can guess.
std::string RandomKey();
