#pragma once

namespace FbxFormat
{
class VSceneBuilder;
}

namespace fbxsdk
{

/// A unit of length as a number of centimetres: scale factor times multiplier.
class FbxSystemUnit
{
public:
	explicit FbxSystemUnit(double pScaleFactor, double pMultiplier = 1.0)
	    : m_ScaleFactor(pScaleFactor), m_Multiplier(pMultiplier)
	{
	}
	double GetScaleFactor() const { return m_ScaleFactor; }
	double GetMultiplier() const { return m_Multiplier; }

private:
	double m_ScaleFactor;
	double m_Multiplier;
};

class FbxAxisSystem
{
public:
	enum EUpVector
	{
		eXAxis = 1,
		eYAxis = 2,
		eZAxis = 3
	};

	/// pSign becomes 1 or -1: the direction of the axis.
	EUpVector GetUpVector(int& pSign) const
	{
		pSign = m_Sign;
		return m_UpVector;
	}

private:
	friend class FbxGlobalSettings;

	FbxAxisSystem(EUpVector i_UpVector, int i_Sign) : m_UpVector(i_UpVector), m_Sign(i_Sign) {}

	EUpVector m_UpVector;
	int m_Sign;
};

class FbxGlobalSettings
{
public:
	FbxSystemUnit GetSystemUnit() const { return FbxSystemUnit(m_UnitScaleFactor); }
	FbxAxisSystem GetAxisSystem() const { return {m_UpVector, m_UpSign}; }

private:
	friend class FbxFormat::VSceneBuilder;

	/// What holds for a file that does not tell: centimetres, Y up.
	double m_UnitScaleFactor = 1.0;
	FbxAxisSystem::EUpVector m_UpVector = FbxAxisSystem::eYAxis;
	int m_UpSign = 1;
};

} // namespace fbxsdk
