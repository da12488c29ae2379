#pragma once

#include <atomic>
#include <functional>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <type_traits>
#include <variant>

namespace NVX
{

enum ELogLevel : int
{
	ELogError = 2,
	ELogWarning = 3,
	ELogInformation = 4,
	ELogDetail = 6
};

/// Resolved once by name and kept per call site; lives as long as the process.
class VLogCategory
{
public:
	explicit VLogCategory(std::string i_Name) : m_Name(std::move(i_Name)) {}
	const std::string& Name() const { return m_Name; }
	bool Enabled(int i_Level) const { return i_Level <= m_Level.load(std::memory_order_relaxed); }
	void SetLevel(int i_Level) { m_Level.store(i_Level, std::memory_order_relaxed); }
	int Level() const { return m_Level.load(std::memory_order_relaxed); }

private:
	std::string m_Name;
	std::atomic<int> m_Level{ELogWarning};
};

using VLogSink = std::function<void(const VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage)>;

/// The host's log: categories by name, and the sinks that receive what passes a category's level. Thread safe.
class GlobalLog
{
public:
	static VLogCategory& Category(const std::string& i_rName);

	/// For all categories, those made later included.
	static void SetDefaultLevel(int i_Level);

	/// The sink receives messages for as long as the returned token lives, on the thread that logs. The token's end
	/// waits for calls of the sink that run on other threads, so that nothing which a sink uses has to outlive its
	/// token: let go of it without a lock that the sink takes. Within a call of any sink it waits for nothing.
	/// While there is no sink, messages go to standard error.
	[[nodiscard]] static std::shared_ptr<void> AddSink(VLogSink i_Sink);
};

} // namespace NVX

namespace LoggingDetail
{

/// Hands a finished message to the sinks.
void GlobalLogStream(const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rMessage);

/// A number or text of a message; refers to the text that it is made of.
class VArgument
{
public:
	template <typename TNumber>
	requires std::is_arithmetic_v<TNumber> || std::is_enum_v<TNumber> VArgument(TNumber i_Number)
	    : m_Value(Widest(i_Number))
	{
	}
	template <typename TText>
	requires std::is_convertible_v<const TText&, std::string_view> VArgument(const TText& i_rText)
	    : m_Value(std::string_view(i_rText))
	{
	}

	const auto& Value() const { return m_Value; }

private:
	template <typename TNumber>
	static auto Widest(TNumber i_Number)
	{
		if constexpr (std::is_floating_point_v<TNumber>)
			return double(i_Number);
		else if constexpr (std::is_same_v<TNumber, char>)
			return i_Number;
		else if constexpr (std::is_unsigned_v<TNumber>)
			return static_cast<unsigned long long>(i_Number);
		else
			return static_cast<long long>(i_Number);
	}

	std::variant<long long, unsigned long long, double, char, std::string_view> m_Value;
};

/// Hands on a message with %1%-style placeholders or printf directives. One that cannot be formatted is told as such at
/// error level instead, so that logging never raises.
void Log(const NVX::VLogCategory& i_rCategory, int i_Level, const char* i_pFormat,
    std::initializer_list<VArgument> i_Arguments);

template <typename... TArguments>
void Log(const NVX::VLogCategory& i_rCategory, int i_Level, const char* i_pFormat, const TArguments&... i_rArguments)
{
	Log(i_rCategory, i_Level, i_pFormat, {VArgument(i_rArguments)...});
}

} // namespace LoggingDetail

/// NVX_LOG("FBXIO", NVX::ELogError, "File %1% not found", path): formats only if the category's level lets it through.
#define NVX_LOG(i_Category, i_Level, ...)                                                                              \
	do                                                                                                                 \
	{                                                                                                                  \
		static NVX::VLogCategory& s_rLogCategory = NVX::GlobalLog::Category(i_Category);                               \
		if (s_rLogCategory.Enabled(i_Level))                                                                           \
			LoggingDetail::Log(s_rLogCategory, i_Level, __VA_ARGS__);                                                  \
	} while (false)
