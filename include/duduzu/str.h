// Character strings: primitives, bounded buffers and radix digit strings.
//
// A heap string is allocated zero-filled with vzl_calloc, exactly its length
// plus one; the caller owns it and releases it with StrFree (or vzl_free).
// The TX routines work in a caller's fixed buffer of `size` bytes (terminator
// included); the PX routines take the address of a heap-string pointer and may
// replace it.
#pragma once

#include <cstdio>

#include "duduzu/export.h"

// Copies and release.
DUDUZU_API char* StrCopy(const char* s);
DUDUZU_API void StrFree(char** p);

// Comparisons. StrCmpRobust gives -1/0/1 and 1 when either side is NULL.
// The NoCase forms compare the lower-case forms of the characters.
DUDUZU_API int StrCmpRobust(const char* a, const char* b);
DUDUZU_API int StrCmpNoCase(const char* a, const char* b);
DUDUZU_API int StrCmpNoCaseN(const char* a, const char* b, int n);
DUDUZU_API int StrIdentical(const char* a, const char* b);
DUDUZU_API int StrCaseIdentical(const char* a, const char* b);
// Position (from 1) of the first of the `count` following strings equal to s
// ignoring case; 0 if none.
DUDUZU_API int StrInEnumOfStrNC(const char* s, int count, ...);
DUDUZU_API int StrFirstCharIsAlpha(char* s);

// In-place changes.
DUDUZU_API void StrUpper(char* s);
DUDUZU_API void StrLower(char* s);
DUDUZU_API char* ToLowerStr(char* s);
DUDUZU_API void StrReverse(char* s);
DUDUZU_API void StrInitChar(int n, char c, char* buf);
DUDUZU_API void StrLeftCat(char* prefix, char* dst);

// Reading and printing.
// Reads one word ended by a white-space character into buf (n bytes) and
// returns that character; at the end of the stream the word read so far is
// kept and '\0' is returned.
DUDUZU_API char StrReadName(char* buf, int n, FILE* f);
DUDUZU_API void StrRead(char* buf, FILE* f);
DUDUZU_API void StrPrint(FILE* f, const char* s);

// Searching and dropping characters.
DUDUZU_API char* StrChr(char* s, char c);
DUDUZU_API char* StrChrSlash(const char* s);
DUDUZU_API char* StrRemoveChar(char* s, char c);
DUDUZU_API char* StrRemoveCharInFront(char* s, char c);
DUDUZU_API void StrRemoveDoubleSlash(char** pp);

// Safe concatenation and copy.
DUDUZU_API void StrSafeCatPX(char** p, const char* src);
DUDUZU_API void StrSafeCatTX(char* dst, const char* src, int size);
DUDUZU_API int StrSafeCopyTX(char* dst, const char* src, int size, int flag);

// Number of characters "%d" prints for n >= 0; -1 for a negative n.
DUDUZU_API int StrIntNbOfChar(int n);

// Radix digit strings. The checks accept the empty string; StrIsBinary and
// StrIsHexa also accept sized constants such as 4'b1010 and 'hFF.
DUDUZU_API int CharIsBinary(char c);
DUDUZU_API int CharIsOctal(char c);
DUDUZU_API int StrIsBinary(const char* s);
DUDUZU_API int StrIsOctal(const char* s);
DUDUZU_API int StrIsDecimal(const char* s);
DUDUZU_API int StrIsHexa(const char* s);

// Converters into a caller's buffer (unchecked input; validate first).
// StrDecimalToBin pads with leading zeros up to the decimal length.
DUDUZU_API void StrOctalToBin(const char* oct, char* bin);
DUDUZU_API void StrHexaToBin(const char* hex, char* bin);
DUDUZU_API void StrDecimalToBin(const char* dec, char* bin);
// n is the number of bits (the length of bin when n < 1); groups from the right.
DUDUZU_API void StrBinToOctal(const char* bin, char* oct, int n);
DUDUZU_API void StrBinToHexa(const char* bin, char* hex, int n);

// Unsigned 32-bit value of a decimal string: 1 on success, 0 after an error report.
DUDUZU_API int StrToUInt(unsigned int* out, char* s);
DUDUZU_API int StrIsAllZero(char* s);
// Every character at positions from .. to - 1 is '1' (an empty range counts).
DUDUZU_API int StrIsAllOne(char* s, int from, int to);
