#pragma once
// Internal: conversion between narrow text in a code page and wide text (UTF-32 where wchar_t has 32 bits,
// UTF-16 where it has 16). Not exported.
#include <string>

namespace svy_text {
namespace detail {

std::wstring decodeNarrow(const char* text, unsigned codePage);
std::string encodeNarrow(const std::wstring& text, unsigned codePage);

}  // namespace detail
}  // namespace svy_text
