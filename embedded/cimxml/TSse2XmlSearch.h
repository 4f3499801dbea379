#pragma once

#include <emmintrin.h>

#include <algorithm>
#include <cstddef>

#include "embedded/cimxml/TPlainXmlSearch.h"

namespace NORVZEL20 {

/// The searches of the tokenizer with SSE2, 16 bytes at a time: see TXmlSearch.
struct TSse2XmlSearch {
    TSse2XmlSearch() = delete;

    static constexpr std::size_t kReadsBeyond = 16;

    static const char* FindSpecial(const char* from, char delimiter) noexcept
    {
        const __m128i less = _mm_set1_epi8('<');
        const __m128i ampersand = _mm_set1_epi8('&');
        const __m128i last = _mm_set1_epi8(delimiter);
        const __m128i blank = _mm_set1_epi8(' ');
        for (;; from += kStep) {
            const __m128i bytes = Load(from);
            const __m128i isMarkup = _mm_or_si128(_mm_cmpeq_epi8(bytes, less), _mm_cmpeq_epi8(bytes, ampersand));
            // The comparison is signed, so bytes beyond ASCII are less than a blank too.
            const __m128i isOther = _mm_or_si128(_mm_cmpeq_epi8(bytes, last), _mm_cmplt_epi8(bytes, blank));
            const int mask = _mm_movemask_epi8(_mm_or_si128(isMarkup, isOther));
            if (mask != 0) {
                return from + __builtin_ctz(static_cast<unsigned int>(mask));
            }
        }
    }

    static bool AreSame(const char* one, const char* other, std::size_t length) noexcept
    {
        std::size_t done = 0;
        for (; done + kStep <= length; done += kStep) {
            if (CompareStep(one + done, other + done) != kAll) {
                return false;
            }
        }
        // The last step may reach beyond the end of both.
        const unsigned int rest = (1U << (length - done)) - 1;
        return done == length || (CompareStep(one + done, other + done) & rest) == rest;
    }

    static std::size_t CountLineEnds(const char* from, const char* to) noexcept
    {
        std::size_t count = 0;
        while (static_cast<std::size_t>(to - from) >= kStep) {
            const char* const end = from + std::min<std::size_t>(static_cast<std::size_t>(to - from) / kStep, kMostSteps) * kStep;
            count += CountInSteps(from, end);
            from = end;
        }
        return count + TPlainXmlSearch::CountLineEnds(from, to);
    }

  private:
    static constexpr std::size_t kStep = kReadsBeyond;
    static constexpr unsigned int kAll = 0xFFFF;
    static constexpr std::size_t kMostSteps = 255;  // each byte of a sum counts so far

    static __m128i Load(const char* from) noexcept { return _mm_loadu_si128(reinterpret_cast<const __m128i*>(from)); }

    /// Counts line feeds first; that is enough for a document without carriage returns.
    static std::size_t CountInSteps(const char* from, const char* to) noexcept
    {
        const __m128i lineFeed = _mm_set1_epi8('\n');
        const __m128i carriageReturn = _mm_set1_epi8('\r');
        __m128i sum = _mm_setzero_si128();
        __m128i returns = _mm_setzero_si128();
        for (const char* at = from; at < to; at += kStep) {
            const __m128i bytes = Load(at);
            sum = _mm_sub_epi8(sum, _mm_cmpeq_epi8(bytes, lineFeed));  // true is -1
            returns = _mm_or_si128(returns, _mm_cmpeq_epi8(bytes, carriageReturn));
        }
        if (_mm_movemask_epi8(returns) != 0) {
            for (const char* at = from; at < to; at += kStep) {
                const __m128i isReturn = _mm_cmpeq_epi8(Load(at), carriageReturn);
                sum = _mm_sub_epi8(sum, _mm_andnot_si128(_mm_cmpeq_epi8(Load(at + 1), lineFeed), isReturn));
            }
        }
        sum = _mm_sad_epu8(sum, _mm_setzero_si128());
        return static_cast<std::size_t>(_mm_cvtsi128_si64(sum)) +
               static_cast<std::size_t>(_mm_cvtsi128_si64(_mm_unpackhi_epi64(sum, sum)));
    }

    static unsigned int CompareStep(const char* one, const char* other) noexcept
    {
        return static_cast<unsigned int>(_mm_movemask_epi8(_mm_cmpeq_epi8(Load(one), Load(other))));
    }
};

}  // namespace NORVZEL20
