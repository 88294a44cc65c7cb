#pragma once

#include "CommonRUKTools/ByteWriter.h"

struct WaveForm {
    std::uint32_t Rate;
    std::uint16_t Channels;
    std::uint16_t Bits;
};

// What stands before the samples of a WAV file, which take so many bytes.
inline ByteWriter WaveHead(const WaveForm& form, std::uint32_t size) {
    const auto block = static_cast<std::uint16_t>(form.Channels * form.Bits / 8);
    ByteWriter head;
    head.Raw("RIFF");
    head.U32Le(36 + size);
    head.Raw("WAVEfmt ");
    head.U32Le(16);
    head.U16Le(1);
    head.U16Le(form.Channels);
    head.U32Le(form.Rate);
    head.U32Le(form.Rate * block);
    head.U16Le(block);
    head.U16Le(form.Bits);
    head.Raw("data");
    head.U32Le(size);
    return head;
}
