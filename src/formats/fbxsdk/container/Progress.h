#pragma once

namespace FbxFormat
{

/// Tells somebody how far an import has got, who may end it.
class VProgress
{
public:
	/// Gets its first argument back, a percentage, and what is being done; false ends the import.
	using VCallback = bool (*)(void*, float, const char*);

	VProgress() = default;
	VProgress(VCallback i_pCallback, void* i_pArguments) : m_pCallback(i_pCallback), m_pArguments(i_pArguments) {}

	/// False from the moment on at which the import was to end.
	bool Tell(float i_Percentage, const char* i_pStatus)
	{
		m_bCancelled = m_bCancelled || (m_pCallback && !m_pCallback(m_pArguments, i_Percentage, i_pStatus));
		return !m_bCancelled;
	}
	bool IsCancelled() const { return m_bCancelled; }

private:
	VCallback m_pCallback = nullptr;
	void* m_pArguments = nullptr;
	bool m_bCancelled = false;
};

} // namespace FbxFormat
