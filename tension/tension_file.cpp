#include "tension/tension_file.h"

#include "base/c_runtime.h"
#include "base/cp932.h"
#include "sound/sound_buffer.h"

#include <cmath>
#include <cstdarg>
#include <cstdio>
#include <cstring>
#include <new>

namespace tension
{
namespace
{

using Byte = unsigned char;

constexpr int kMinimumLengthSeconds = 60;
constexpr int kMaximumLengthSeconds = 480;
constexpr std::size_t kNameLimit = 40;
constexpr std::size_t kCommentLimit = 160;
constexpr int kCommentLineFeedLimit = 4;
constexpr std::size_t kCommentLineLimit = 40;
// Both factors are the single-precision values, widened.
constexpr double kFinaleFactor1 = 0.1f;
constexpr double kFinaleFactor2 = 0.2f;
constexpr double kHiFactor = 0.2f;
constexpr double kClimaxFactor = 0.1f;
constexpr int kLevelCount = kTensionLevelCount;
constexpr int kNoLevel = 4;
constexpr int kSegmentLimits[kLevelCount] = {4, 10, 4, 2};
constexpr const char* kLevelNames[kLevelCount] = {"LowTension", "NormalTension", "HiTension",
                                                  "ClimaxTension"};

constexpr const char* kFileNameKeys[] = {"ファイル名", "名前", "NAME", "FILENAME", "FN"};
constexpr const char* kCommentKeys[] = {"ファイルコメント", "コメント", "COMMENT", "FILECOMMENT",
                                        "FC"};
constexpr const char* kFinaleKeys[] = {"クライマックスフィナーレ", "フィナーレ", "FINALE",
                                       "CLIMAXFINALE", "CF"};
constexpr const char* kLevelKeys[kLevelCount][5] = {
    {"ローテンション", "ロー", "LOW", "LOWTENSION", "LT"},
    {"ノーマルテンション", "ノーマル", "NORMAL", "NORMALTENSION", "NT"},
    {"ハイテンション", "ハイ", "HI", "HITENSION", "HT"},
    {"クライマックステンション", "クライマックス", "CLIMAX", "CLIMAXTENSION", "CT"},
};

bool IsBlank(Byte c)
{
    return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\v';
}

bool IsLead(Byte c)
{
    return base::IsLeadByte(c);
}

bool MatchesAny(const char* key, const char* const (&keys)[5])
{
    for (const char* candidate : keys)
    {
        if (std::strcmp(key, candidate) == 0)
            return true;
    }
    return false;
}

void Record(CTextString* log, const char* message)
{
    if (log == nullptr)
        return;
    log->Append(message);
    log->Append("\n");
}

[[gnu::format(printf, 2, 3)]] void RecordFormatted(CTextString* log, const char* format, ...)
{
    if (log == nullptr)
        return;
    char message[512];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(message, sizeof message, format, arguments);
    va_end(arguments);
    Record(log, message);
}

float LengthOf(sound::CSoundBuffer* sound)
{
    return sound != nullptr ? sound->GetLength() : 0.0f;
}

// The size of the character at `text[position]`: 2 for a lead byte and its
// trail, 1 otherwise, 0 at the end of the text (the zero itself, or a lead
// byte whose trail would be the zero).
std::size_t CharacterAt(const Byte* text, std::size_t position)
{
    const Byte c = text[position];
    if (c == 0)
        return 0;
    if (IsLead(c))
        return text[position + 1] == 0 ? 0 : 2;
    return 1;
}

// Moves past the next `terminator` (double-byte aware). False when the text
// ends first; `position` is then at its end.
bool SkipPast(const Byte* text, std::size_t* position, Byte terminator)
{
    std::size_t p = *position;
    for (std::size_t size; (size = CharacterAt(text, p)) != 0; p += size)
    {
        if (size == 1 && text[p] == terminator)
        {
            *position = p + 1;
            return true;
        }
    }
    *position = p;
    return false;
}

// Moves past the next "*/". False when the text ends first.
bool SkipBlockComment(const Byte* text, std::size_t* position)
{
    std::size_t p = *position;
    for (std::size_t size; (size = CharacterAt(text, p)) != 0; p += size)
    {
        if (text[p] == '*' && text[p + 1] == '/')
        {
            *position = p + 2;
            return true;
        }
    }
    return false;
}

// Collects one key: blanks before its first character are not stored and
// blanks after its last are held back until another character follows, so
// that the stored key is already trimmed at both ends. A key that does not
// fit is marked too long and names nothing.
class KeyCollector
{
public:
    void Add(const Byte* bytes, std::size_t size, bool blank)
    {
        if (tooLong_)
            return;
        if (blank)
        {
            if (length_ == 0)
                return;
            if (length_ + size < CTensionFile::kKeyCapacity && !blanksDropped_)
                Store(bytes, size);
            else
                blanksDropped_ = true;
            return;
        }
        if (blanksDropped_ || length_ + size >= CTensionFile::kKeyCapacity)
        {
            tooLong_ = true;
            return;
        }
        Store(bytes, size);
        end_ = length_;
    }

    // The trimmed key; a key too long to name anything reads as "", which
    // names nothing either.
    const char* Finish()
    {
        buffer_[tooLong_ ? 0 : end_] = '\0';
        return buffer_;
    }

    void Clear() { *this = KeyCollector(); }

private:
    void Store(const Byte* bytes, std::size_t size)
    {
        std::memcpy(buffer_ + length_, bytes, size);
        length_ += size;
    }

    char buffer_[CTensionFile::kKeyCapacity] = {};
    std::size_t length_ = 0;
    std::size_t end_ = 0;
    bool blanksDropped_ = false;
    bool tooLong_ = false;
};

} // namespace

const char* LevelMessageName(TensionLevel level)
{
    const auto index = static_cast<int>(level);
    return index >= 0 && index < kLevelCount ? kLevelNames[index] : "";
}

CTensionFile::CTensionFile() = default;

CTensionFile::CTensionFile(const CTensionFile& other)
    : sound_(other.sound_), name_(other.name_), comment_(other.comment_),
      loopStart_(other.loopStart_), finaleTime_(other.finaleTime_),
      finaleWindow_(other.finaleWindow_)
{
    if (other.timeline_ != nullptr)
        timeline_ = other.timeline_->Clone();
}

CTensionFile::~CTensionFile()
{
    ReleaseTimeline();
}

bool CTensionFile::LoadFromArchive(sound::CSoundBuffer* sound, const char* entryName,
                                   const CqvxPackFile* archive, CTextString* log)
{
    const std::uint8_t* bytes = nullptr;
    std::uint32_t size = 0;
    const std::int32_t index =
        archive != nullptr && entryName != nullptr ? archive->FindEntry(entryName) : -1;
    if (index < 0 || !archive->GetEntryBytes(index, &bytes, &size))
    {
        Record(log, "ファイルが開けません!!");
        return false;
    }
    name_.Assign(entryName);
    sound_ = sound;
    auto* text = static_cast<char*>(base::AllocateZeroed(std::size_t(size) + 1));
    if (text == nullptr)
    {
        Record(log, "File Buffer Allocator Error!!");
        return false;
    }
    if (size != 0)
        std::memcpy(text, bytes, size);
    const bool parsed = Parse(sound, text, ':', ';', log);
    if (!parsed)
        Record(log, "File Buffer Conversion Error!!");
    base::FreeBlock(text);
    return parsed;
}

bool CTensionFile::LoadFromArchiveList(sound::CSoundBuffer* sound, const char* entryName,
                                       const CqvxPackFileList& archives, CTextString* log)
{
    for (std::uint32_t i = 0; i < archives.count; ++i)
    {
        const CqvxPackFile* archive = archives.archives[i];
        if (archive == nullptr || archive->FindEntry(entryName) < 0)
            continue;
        if (LoadFromArchive(sound, entryName, archive, log))
            return true;
    }
    return false;
}

bool CTensionFile::LoadFromFile(sound::CSoundBuffer* sound, const char* path, CTextString* log)
{
    // Read as bytes and translated here, so that every build sees the text
    // the game sees through the Windows runtime's text mode.
    std::FILE* file = path != nullptr ? std::fopen(path, "rb") : nullptr;
    std::size_t count = 0;
    if (file != nullptr)
    {
        char chunk[4096];
        for (std::size_t got; (got = std::fread(chunk, 1, sizeof chunk, file)) != 0;)
            count += got;
        // A file that opens but cannot be read (a directory on POSIX) is
        // one that does not open.
        if (std::ferror(file))
        {
            std::fclose(file);
            file = nullptr;
        }
    }
    if (file == nullptr)
    {
        Record(log, "ファイルが開けません!!");
        return false;
    }
    name_.Assign(path);
    sound_ = sound;
    std::rewind(file);
    auto* text = static_cast<char*>(base::AllocateZeroed(count + 1));
    if (text == nullptr)
    {
        std::fclose(file);
        Record(log, "File Buffer Allocator Error!!");
        return false;
    }
    text[base::TranslateTextMode(text, std::fread(text, 1, count, file))] = '\0';
    std::fclose(file);
    const bool parsed = Parse(sound, text, ':', ';', log);
    if (!parsed)
        Record(log, "変換エラー!!");
    base::FreeBlock(text);
    return parsed;
}

bool CTensionFile::Parse(sound::CSoundBuffer* sound, const char* text, char separator,
                         char terminator, CTextString* log)
{
    int finaleCount = 0;
    if (!Scan(LengthOf(sound), text, separator, terminator, log, &finaleCount))
        return false;
    return Finish(IsCorrect(sound, log), finaleCount, log);
}

bool CTensionFile::ParseForLength(float length, const char* text, char separator, char terminator,
                                  CTextString* log)
{
    int finaleCount = 0;
    if (!Scan(length, text, separator, terminator, log, &finaleCount))
        return false;
    bool checked = CheckLength(length, log);
    if (checked)
    {
        const bool name = CheckFileName(nullptr, log);
        const bool comment = CheckComment(nullptr, log);
        const bool timeline = CheckTimelineFor(length, log);
        checked = name && comment && timeline;
    }
    return Finish(checked, finaleCount, log);
}

bool CTensionFile::Scan(float length, const char* text, char separator, char terminator,
                        CTextString* log, int* finaleCount)
{
    if (text == nullptr)
        return false;
    ReleaseTimeline();
    timeline_ = new (std::nothrow) CKeyFrameList("Tension");
    if (timeline_ == nullptr)
        return false;
    constexpr auto kNormal = static_cast<std::int32_t>(TensionLevel::Normal);
    timeline_->KeyAdd(kNormal, 0.0f, 0.0f);
    timeline_->KeyAdd(kNormal, length, 0.0f);
    finaleTime_ = 0.0f;
    finaleWindow_ = static_cast<float>(length * kFinaleFactor1 * kFinaleFactor2);
    *finaleCount = 0;

    const auto* bytes = reinterpret_cast<const Byte*>(text);
    KeyCollector key;
    std::size_t position = 0;
    for (;;)
    {
        const std::size_t size = CharacterAt(bytes, position);
        if (size == 0)
            break;
        const Byte c = bytes[position];
        if (size == 2)
        {
            key.Add(bytes + position, 2, false);
            position += 2;
            continue;
        }
        if (c == '/' && bytes[position + 1] == '/')
        {
            position += 2;
            if (!SkipPast(bytes, &position, '\n'))
                break;
            continue;
        }
        if (c == '/' && bytes[position + 1] == '*')
        {
            position += 2;
            if (!SkipBlockComment(bytes, &position))
                return false;
            continue;
        }
        if (c != static_cast<Byte>(separator))
        {
            const Byte upper = (c >= 'a' && c <= 'z') ? Byte(c - 'a' + 'A') : c;
            key.Add(&upper, 1, IsBlank(c));
            ++position;
            continue;
        }

        const char* entry = key.Finish();
        ++position;
        bool passOver = true;
        if (IsFileNameKey(entry))
        {
            ReadFileName(text, terminator, &position);
        }
        else if (IsCommentKey(entry))
        {
            ReadComment(text, terminator, &position);
        }
        else if (IsFinaleKey(entry))
        {
            ++*finaleCount;
            finaleTime_ = ReadTime(text, terminator, &position);
        }
        else if (const int level = GetTensionIndex(entry); level != kNoLevel)
        {
            const float time = ReadTime(text, terminator, &position);
            if (time > 0.0f && time < length)
            {
                if (timeline_->KeyAdd(level, time, 0.0f))
                    passOver = false;
                else
                    Record(log, "Time Data KeyAdd Error!!");
            }
            else
            {
                Record(log, "Time Data Outside Range!!");
            }
        }
        else
        {
            SkipPast(bytes, &position, static_cast<Byte>(terminator));
            Record(log, "Time Data Not Tension!!");
            passOver = false;
        }
        key.Clear();
        // The one character after the terminator, a line feed in a file
        // written one entry per line.
        if (passOver)
            position += CharacterAt(bytes, position);
    }
    return true;
}

bool CTensionFile::Finish(bool checked, int finaleCount, CTextString* log)
{
    if (checked && finaleCount <= 1)
        return true;
    if (finaleCount >= 2)
        Record(log,
               "クライマックスフィナーレ エラー[クライマックスフィナーレが複数指定されています]");
    Record(log, "Time Data IsCorrect Error!!");
    return false;
}

bool CTensionFile::IsFileNameKey(const char* key)
{
    return MatchesAny(key, kFileNameKeys);
}

bool CTensionFile::ReadValue(const char* text, char terminator, std::size_t* position, char* value,
                             bool* cut)
{
    const auto* bytes = reinterpret_cast<const Byte*>(text);
    const std::size_t start = *position;
    if (!SkipPast(bytes, position, static_cast<Byte>(terminator)))
        return false;
    std::size_t begin = start;
    std::size_t end = *position - 1;
    // Trail bytes are never blanks, so the trim cannot split a character.
    while (begin < end && IsBlank(bytes[begin]))
        ++begin;
    while (end > begin && IsBlank(bytes[end - 1]))
        --end;
    std::size_t length = 0;
    for (std::size_t p = begin; p < end;)
    {
        const std::size_t size = IsLead(bytes[p]) && p + 1 < end ? 2 : 1;
        if (length + size >= kValueCapacity)
            break;
        std::memcpy(value + length, bytes + p, size);
        length += size;
        p += size;
    }
    value[length] = '\0';
    *cut = begin + length < end;
    return true;
}

bool CTensionFile::ReadFileName(const char* text, char terminator, std::size_t* position)
{
    char value[kValueCapacity];
    bool cut = false;
    if (!ReadValue(text, terminator, position, value, &cut))
        return false;
    name_.Assign(value);
    return true;
}

bool CTensionFile::IsCommentKey(const char* key)
{
    return MatchesAny(key, kCommentKeys);
}

bool CTensionFile::ReadComment(const char* text, char terminator, std::size_t* position)
{
    char value[kValueCapacity];
    bool cut = false;
    if (!ReadValue(text, terminator, position, value, &cut))
        return false;
    comment_.Assign(value);
    return true;
}

float CTensionFile::ReadTime(const char* text, char terminator, std::size_t* position)
{
    char value[kValueCapacity];
    bool cut = false;
    if (!ReadValue(text, terminator, position, value, &cut) || cut)
        return -1.0f;
    return static_cast<float>(base::ReadDecimal(value));
}

int CTensionFile::GetTensionIndex(const char* key)
{
    for (int level = 0; level < kLevelCount; ++level)
    {
        if (MatchesAny(key, kLevelKeys[level]))
            return level;
    }
    return kNoLevel;
}

bool CTensionFile::IsFinaleKey(const char* key)
{
    return MatchesAny(key, kFinaleKeys);
}

bool CTensionFile::ReleaseTimeline()
{
    if (timeline_ != nullptr)
    {
        delete timeline_;
        timeline_ = nullptr;
    }
    return true;
}

bool CTensionFile::IsCorrect(sound::CSoundBuffer* sound, CTextString* log)
{
    if (!CheckLength(LengthOf(sound), log))
        return false;
    const bool name = CheckFileName(sound, log);
    const bool comment = CheckComment(sound, log);
    const bool timeline = CheckTimeline(sound, log);
    return name && comment && timeline;
}

bool CTensionFile::CheckLength(float length, CTextString* log)
{
    // Written so that a length that is not a number fails too.
    if (!(length >= kShortestMusic))
    {
        RecordFormatted(
            log, "ファイル時間 エラー[%f秒のファイルです : %d秒以上の長さのファイルが必要です]",
            static_cast<double>(length), kMinimumLengthSeconds);
        return false;
    }
    if (length > kLongestMusic)
    {
        RecordFormatted(
            log, "ファイル時間 エラー[%f秒のファイルです : %d秒以下の長さのファイルが必要です]",
            static_cast<double>(length), kMaximumLengthSeconds);
        return false;
    }
    return true;
}

bool CTensionFile::CheckFileName(sound::CSoundBuffer*, CTextString* log)
{
    if (name_.Length() >= 1 && name_.Length() <= kNameLimit)
        return true;
    RecordFormatted(log, "ファイル名 エラー[ファイル名を 1 ～ %d 文字以内にしてください]",
                    static_cast<int>(kNameLimit));
    return false;
}

bool CTensionFile::CheckComment(sound::CSoundBuffer*, CTextString* log)
{
    if (comment_.Length() > kCommentLimit)
    {
        RecordFormatted(log, "ファイルコメント エラー[文字数を %d 以内にしてください]",
                        static_cast<int>(kCommentLimit));
        return false;
    }
    const auto* bytes = reinterpret_cast<const Byte*>(comment_.CStr());
    int lineFeeds = 0;
    std::size_t lineBytes = 0;
    for (std::size_t p = 0, size; (size = CharacterAt(bytes, p)) != 0; p += size)
    {
        if (bytes[p] == '\n')
        {
            lineBytes = 0;
            if (++lineFeeds == kCommentLineFeedLimit)
            {
                RecordFormatted(log, "ファイルコメント エラー[行数を %d 以内にしてください]",
                                kCommentLineFeedLimit);
                return false;
            }
        }
        else if (bytes[p] != '\r')
        {
            lineBytes += size;
            if (lineBytes > kCommentLineLimit)
            {
                RecordFormatted(log, "ファイルコメント エラー[1行の文字数を %d 以内にしてください]",
                                static_cast<int>(kCommentLineLimit));
                return false;
            }
        }
    }
    return true;
}

bool CTensionFile::CheckTimeline(sound::CSoundBuffer* sound, CTextString* log)
{
    return CheckTimelineFor(LengthOf(sound), log);
}

TimelineTally CTensionFile::TallyTimeline(float length) const
{
    TimelineTally tally{};
    const std::uint32_t keys = timeline_ != nullptr ? timeline_->GetKeyCount() : 0;
    for (std::uint32_t i = 0; i + 1 < keys; ++i)
    {
        const KeyFrame* key = timeline_->GetKey(i);
        const KeyFrame* next = timeline_->GetKey(i + 1);
        if (key->value < 0 || key->value >= kLevelCount)
            continue;
        tally.levels[key->value].totalSeconds += next->time - key->time;
        ++tally.levels[key->value].segments;
    }
    // The integer part of the limit; lengths beyond 480 s never reach the
    // check from IsCorrect, the clamp only keeps a direct call defined.
    const auto limit = [length](double factor)
    {
        const double product = std::trunc(length * factor);
        return product < 1.0e9 ? static_cast<int>(product) : 1000000000;
    };
    const int timeLimits[kLevelCount] = {kNoTimeLimit, kNoTimeLimit, limit(kHiFactor),
                                         limit(kClimaxFactor)};
    for (int level = 0; level < kLevelCount; ++level)
    {
        tally.levels[level].timeLimit = timeLimits[level];
        tally.levels[level].segmentLimit = kSegmentLimits[level];
    }
    return tally;
}

bool CTensionFile::CheckTimelineFor(float length, CTextString* log)
{
    const TimelineTally tally = TallyTimeline(length);
    bool correct = true;
    for (int level = 0; level < kLevelCount; ++level)
    {
        const LevelTally& measured = tally.levels[level];
        if (measured.timeLimit != kNoTimeLimit &&
            measured.totalSeconds > static_cast<float>(measured.timeLimit))
        {
            RecordFormatted(log, "%s 時間オーバー[現在 %f 秒です %d 秒以内にしてください]",
                            kLevelNames[level], static_cast<double>(measured.totalSeconds),
                            measured.timeLimit);
            correct = false;
        }
        if (measured.segments > measured.segmentLimit)
        {
            RecordFormatted(log, "%s 回数オーバー[現在 %d 回です %d 回以内にしてください]",
                            kLevelNames[level], measured.segments, measured.segmentLimit);
            correct = false;
        }
    }
    const float low = tally.levels[static_cast<int>(TensionLevel::Low)].totalSeconds;
    const float hi = tally.levels[static_cast<int>(TensionLevel::Hi)].totalSeconds;
    if (hi > low)
    {
        RecordFormatted(log, "%s 時間不足[現在 %f 秒です HiTension 時間の %f 秒以上必要です]",
                        kLevelNames[static_cast<int>(TensionLevel::Low)], static_cast<double>(low),
                        static_cast<double>(hi));
        correct = false;
    }
    return correct;
}

float CTensionFile::FoldTime(float time) const
{
    const std::uint32_t keys = timeline_ != nullptr ? timeline_->GetKeyCount() : 0;
    const float end = keys != 0 ? timeline_->GetKey(keys - 1)->time : 0.0f;
    if (time <= end)
        return time;
    return loopStart_ + std::fmod(time - end, end - loopStart_);
}

TensionLevel CTensionFile::GetTension(float time)
{
    std::int32_t value = 0;
    if (timeline_ == nullptr || !timeline_->Evaluate(FoldTime(time), &value))
        return TensionLevel::Normal;
    return static_cast<TensionLevel>(value);
}

bool CTensionFile::IsFinale(float time)
{
    const float folded = FoldTime(time);
    return finaleTime_ <= folded && folded <= finaleTime_ + finaleWindow_ &&
           GetTension(time) == TensionLevel::Climax;
}

} // namespace tension
