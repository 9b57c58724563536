#include "sound/loudness.h"

#include "sound/audio_file.h"

#include <algorithm>
#include <cmath>
#include <condition_variable>
#include <cstring>
#include <ebur128.h>
#include <mutex>
#include <thread>

namespace sound
{
namespace
{

// Frames converted at a time for the formats libebur128 does not read
// itself.
constexpr std::size_t kScratchFrames = 4096;

double Rounded(double loudness)
{
    if (!std::isfinite(loudness) || loudness < kQuietestLoudness)
        return kQuietestLoudness;
    return std::round(loudness * 100.0) / 100.0;
}

double SampleAt(const std::uint8_t* bytes, std::uint16_t tag, std::uint16_t size)
{
    if (tag == kFormatTagIeeeFloat && size == 4)
    {
        float value;
        std::memcpy(&value, bytes, sizeof value);
        return value;
    }
    if (tag == kFormatTagIeeeFloat)
    {
        double value;
        std::memcpy(&value, bytes, sizeof value);
        return value;
    }
    if (size == 1)
        return (bytes[0] - 128) / 128.0;
    // Little-endian and signed: the top byte carries the sign.
    std::int64_t value = static_cast<std::int8_t>(bytes[size - 1]);
    for (int i = size - 2; i >= 0; --i)
        value = value * 256 + bytes[i];
    return static_cast<double>(value) / std::ldexp(1.0, 8 * size - 1);
}

} // namespace

struct CLoudnessMeter::Filter
{
    explicit Filter(ebur128_state* made) : state(made) {}
    ~Filter() { ebur128_destroy(&state); }
    Filter(const Filter&) = delete;
    Filter& operator=(const Filter&) = delete;

    ebur128_state* state;
};

CLoudnessMeter::CLoudnessMeter(const WaveFormat& format)
{
    if (!IsPlayableFormat(format) || format.samplesPerSec < kLowestMeasuredRate)
        return;
    sampleTag_ = SampleFormatTag(format);
    bytesPerSample_ = static_cast<std::uint16_t>(format.bitsPerSample / 8);
    const bool integer = sampleTag_ == kFormatTagPcm && bytesPerSample_ <= 4;
    const bool floating =
        sampleTag_ == kFormatTagIeeeFloat && (bytesPerSample_ == 4 || bytesPerSample_ == 8);
    if (!integer && !floating)
        return;
    frameBytes_ = format.blockAlign;
    rate_ = format.samplesPerSec;
    ebur128_state* state = ebur128_init(format.channels, rate_, EBUR128_MODE_S);
    if (state != nullptr)
        filter_ = std::make_unique<Filter>(state);
}

CLoudnessMeter::~CLoudnessMeter() = default;

void CLoudnessMeter::MeasureUpTo(const std::uint8_t* block, std::size_t availableBytes)
{
    if (filter_ == nullptr)
        return;
    const std::uint64_t frames = availableBytes / frameBytes_;
    while (filter_ != nullptr && measuredFrames_ < frames)
    {
        const std::uint64_t mark = (measuredFrames_ / rate_ + 1) * rate_;
        const std::uint64_t count = std::min(frames, mark) - measuredFrames_;
        Feed(block + measuredFrames_ * frameBytes_, static_cast<std::size_t>(count));
        measuredFrames_ += count;
        if (measuredFrames_ == mark)
            TakeValue();
    }
}

void CLoudnessMeter::Feed(const std::uint8_t* frames, std::size_t count)
{
    int result = EBUR128_SUCCESS;
    if (sampleTag_ == kFormatTagPcm && bytesPerSample_ == 2)
    {
        result =
            ebur128_add_frames_short(filter_->state, reinterpret_cast<const short*>(frames), count);
    }
    else
    {
        const std::size_t channels = frameBytes_ / bytesPerSample_;
        scratch_.resize(kScratchFrames * channels);
        for (std::size_t done = 0; done < count && result == EBUR128_SUCCESS;)
        {
            const std::size_t piece = std::min(kScratchFrames, count - done);
            const std::uint8_t* sample = frames + done * frameBytes_;
            for (std::size_t i = 0; i < piece * channels; ++i, sample += bytesPerSample_)
                scratch_[i] = SampleAt(sample, sampleTag_, bytesPerSample_);
            result = ebur128_add_frames_double(filter_->state, scratch_.data(), piece);
            done += piece;
        }
    }
    if (result != EBUR128_SUCCESS)
    {
        filter_.reset();
        windowEnds_.clear();
    }
}

void CLoudnessMeter::TakeValue()
{
    double loudness = kQuietestLoudness;
    if (ebur128_loudness_shortterm(filter_->state, &loudness) != EBUR128_SUCCESS)
        loudness = kQuietestLoudness;
    windowEnds_.push_back(Rounded(loudness));
}

std::vector<double> CLoudnessMeter::Finish()
{
    if (filter_ == nullptr)
        return {};
    if (measuredFrames_ % rate_ != 0)
        TakeValue();
    // The window centred on second i ends at mark i + 2.
    std::vector<double> values(static_cast<std::size_t>(measuredFrames_ / rate_));
    for (std::size_t i = 0; i < values.size(); ++i)
        values[i] = windowEnds_[std::min(i + 1, windowEnds_.size() - 1)];
    return values;
}

std::vector<double> MeasureLoudness(const WaveFormat& format, const std::uint8_t* pcm,
                                    std::size_t bytes)
{
    CLoudnessMeter meter(format);
    meter.MeasureUpTo(pcm, bytes);
    return meter.Finish();
}

namespace
{

// The decode hands its progress to a thread that measures what is final;
// the two meet only here, under the lock.
class MeasuringThread
{
public:
    MeasuringThread() : thread_([this] { Run(); }) {}
    ~MeasuringThread() { End(false); }
    MeasuringThread(const MeasuringThread&) = delete;
    MeasuringThread& operator=(const MeasuringThread&) = delete;

    void Publish(const DecodedAudio& audio, std::uint32_t decodedBytes)
    {
        if (decodedBytes == 0)
        {
            // The block is about to be freed.
            End(false);
            return;
        }
        const std::lock_guard<std::mutex> lock(mutex_);
        format_ = audio.format;
        block_ = audio.data;
        available_ = decodedBytes;
        if (available_ - woken_ >= kWakeBytes)
        {
            woken_ = available_;
            wake_.notify_one();
        }
    }

    // Waits for the measure; the values only when the decode `succeeded`.
    std::vector<double> End(bool succeeded)
    {
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            ended_ = true;
            succeeded_ = succeeded;
            wake_.notify_one();
        }
        if (thread_.joinable())
            thread_.join();
        return succeeded_ ? std::move(values_) : std::vector<double>();
    }

private:
    static constexpr std::size_t kWakeBytes = 64 * 1024;

    void Run()
    {
        std::unique_lock<std::mutex> lock(mutex_);
        wake_.wait(lock, [this] { return format_ != nullptr || ended_; });
        if (format_ == nullptr)
            return;
        CLoudnessMeter meter(*format_);
        std::size_t measured = 0;
        while (meter.CanMeasure())
        {
            wake_.wait(lock, [&] { return available_ - measured >= kWakeBytes || ended_; });
            const std::uint8_t* block = block_;
            const std::size_t available = available_;
            const bool last = ended_;
            lock.unlock();
            meter.MeasureUpTo(block, available);
            measured = available;
            lock.lock();
            if (last)
                break;
        }
        if (ended_ && succeeded_)
            values_ = meter.Finish();
    }

    std::mutex mutex_;
    std::condition_variable wake_;
    const WaveFormat* format_ = nullptr;
    const std::uint8_t* block_ = nullptr;
    std::size_t available_ = 0;
    std::size_t woken_ = 0;
    bool ended_ = false;
    bool succeeded_ = false;
    std::vector<double> values_;
    std::thread thread_;
};

} // namespace

bool MeasureMusic(const char* path, MusicMeasure* out)
{
    *out = MusicMeasure{};
    DecodedAudio audio;
    SourceKind kind;
    MeasuringThread measuring;
    const bool decoded =
        DecodeAudioFile(path, &audio, &kind,
                        [&measuring](const DecodedAudio& decoding, std::uint32_t bytes)
                        { measuring.Publish(decoding, bytes); });
    const bool opens = decoded && FitsStaticBuffer(*audio.format, audio.dataBytes);
    out->loudness = measuring.End(opens);
    if (!opens)
        return false;
    out->length = ComputeLength(audio.dataBytes, *audio.format);
    return true;
}

} // namespace sound
