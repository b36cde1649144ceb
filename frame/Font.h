#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "frame/Object.h"

namespace tessel::frame {

class FontHolder;

/// A font, shared by those who hold it: a change of one of its members is told to every holder.
class Font final : public Object {
  public:
    Font() = default;
    Font(std::string name, double size) : name_(std::move(name)) { SetSize(size); }

    const std::string& Name() const { return name_; }
    void SetName(const std::string& value);
    /// In points, kept to four decimals. Error 380 for a size that is not above 0 or above 2048, NaN included.
    double Size() const { return size_; }
    void SetSize(double value);
    bool Bold() const { return weight_ > mediumWeight; }
    /// Sets `Weight` to 700 or 400.
    void SetBold(bool value);
    bool Italic() const { return italic_; }
    void SetItalic(bool value);
    bool Underline() const { return underline_; }
    void SetUnderline(bool value);
    bool Strikethrough() const { return strikethrough_; }
    void SetStrikethrough(bool value);
    /// 400 is normal, 700 bold.
    std::int16_t Weight() const { return weight_; }
    void SetWeight(std::int16_t value);
    std::int16_t Charset() const { return charset_; }
    void SetCharset(std::int16_t value);

    std::shared_ptr<Font> Copy() const;

    const ClassTable& Table() const override;
    bool EqualsObject(const Object& other) const override;

  private:
    friend class FontHolder;
    static constexpr std::int16_t normalWeight = 400, mediumWeight = 550, boldWeight = 700;
    template <class T>
    void Store(T& field, const T& value);

    std::string name_ = "MS Sans Serif";
    double size_ = 8.25;
    std::int16_t weight_ = normalWeight;
    std::int16_t charset_ = 0;
    bool italic_ = false, underline_ = false, strikethrough_ = false;
    std::vector<FontHolder*> holders_;
};

using FontRef = std::shared_ptr<Font>;

/// One who holds a font and hears of its changes.
class FontHolder {
  public:
    explicit FontHolder(std::function<void()> changed = {}) : changed_(std::move(changed)) {}
    FontHolder(const FontHolder&) = delete;
    FontHolder& operator=(const FontHolder&) = delete;
    ~FontHolder() { Set(nullptr); }

    const FontRef& Get() const { return font_; }
    /// Takes another font; the holder is told by its caller, not by this.
    void Set(FontRef font);

  private:
    friend class Font;
    std::function<void()> changed_;
    FontRef font_;
};

}  // namespace tessel::frame
