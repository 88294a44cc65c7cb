#include "MusicManagment/playback/fmod/ModuleSource.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <libopenmpt/libopenmpt.hpp>
#include <ostream>
#include <string_view>

namespace {

struct Kind {
    std::string_view name;
    FMUSIC_TYPES type;
};
constexpr std::array kKinds = {
    Kind{"mod", FMUSIC_TYPE_MOD},
    Kind{"s3m", FMUSIC_TYPE_S3M},
    Kind{"xm", FMUSIC_TYPE_XM},
    Kind{"it", FMUSIC_TYPE_IT},
};

FMUSIC_TYPES TypeOf(const openmpt::module& module) {
    const std::string name = module.get_metadata("type");
    const auto kind =
        std::find_if(kKinds.begin(), kKinds.end(), [&](const Kind& k) { return k.name == name; });
    return kind != kKinds.end() ? kind->type : FMUSIC_TYPE_NONE;
}

class Module : public SongSource {
 public:
    Module(ByteSpan file, int rate)
        : module_(file.data(), file.size(), nowhere_), rate_(rate), type_(TypeOf(module_)) {
        module_.set_repeat_count(0);
        module_.ctl_set_text("play.at_end", "stop");
    }

    std::size_t Read(float* stereo, std::size_t frames) override {
        std::size_t done = 0;
        while (done < frames && !ended_) {
            const std::size_t count =
                module_.read_interleaved_stereo(rate_, frames - done, stereo + 2 * done);
            ended_ = count == 0;
            done += count;
        }
        return done;
    }

    std::uint64_t Seek(std::uint64_t frame) override {
        ended_ = false;
        return ToFrames(module_.set_position_seconds(static_cast<double>(frame) / rate_));
    }

    std::uint64_t SeekOrder(int order) override {
        ended_ = false;
        return ToFrames(module_.set_position_order_row(order, 0));
    }

    std::uint64_t Length() const override { return ToFrames(module_.get_duration_seconds()); }
    FMUSIC_TYPES Type() const override { return type_; }
    int Orders() const override { return module_.get_num_orders(); }
    int PatternRows(int pattern) const override { return std::max(0, module_.get_pattern_num_rows(pattern)); }

    // After its end a module stands at the order where it would start again.
    SongPlace Place() const override {
        if (ended_) return {Orders(), 0};
        return {module_.get_current_order(), module_.get_current_row()};
    }

    void SetSeparation(float separation) override {
        module_.set_render_param(openmpt::module::RENDER_STEREOSEPARATION_PERCENT,
                                 static_cast<int>(std::lround(separation * 100)));
    }

 private:
    std::uint64_t ToFrames(double seconds) const {
        return static_cast<std::uint64_t>(std::llround(std::max(0.0, seconds) * rate_));
    }

    std::ostream nowhere_{nullptr};  // for the library's remarks
    openmpt::module module_;
    const int rate_;
    const FMUSIC_TYPES type_;
    bool ended_ = false;
};

}  // namespace

bool ModuleSource::Probe(ByteSpan head, std::uint64_t fileSize) {
    const int result = openmpt::probe_file_header(openmpt::probe_file_header_flags_modules2, head.data(),
                                                  head.size(), fileSize);
    return result == openmpt::probe_file_header_result_success;
}

std::unique_ptr<SongSource> ModuleSource::Load(ByteSpan file, int rate) {
    try {
        auto module = std::make_unique<Module>(file, rate);
        if (module->Type() != FMUSIC_TYPE_NONE && module->Orders() > 0) return module;
    } catch (const openmpt::exception&) {
        throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
    }
    throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
}
