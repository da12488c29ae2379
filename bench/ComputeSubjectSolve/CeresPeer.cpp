#include "CeresPeer.h"

#include "ComputeSubjectSolve/SolveObjective.h"
#include "CoreOrlexTypes/Subject.h"

#include <ceres/ceres.h>
#include <ceres/rotation.h>

#include <Eigen/Geometry>

namespace
{

using CoreOrlexTypes::VSubject;
using Eigen::Matrix3d;
using Eigen::Quaterniond;
using Eigen::Vector3d;
using VRows = Eigen::Matrix<double, 3, 3, Eigen::RowMajor>;

struct VJointState
{
	Quaterniond m_Rotation = Quaterniond::Identity();
	Vector3d m_Position = Vector3d::Zero();
};

struct VModel
{
	explicit VModel(const VSubject& i_rSubject) : m_rSubject(i_rSubject)
	{
		for (const auto& rSegment : i_rSubject.m_Segments)
		{
			const Vector3d pre(rSegment.m_PreRotation.data());
			m_PreRotations.emplace_back(Eigen::AngleAxisd(pre.norm(), pre.stableNormalized()));
			m_PreTranslations.emplace_back(rSegment.m_PreTranslation.data());
		}
		m_States.resize(m_PreRotations.size());
		m_Before.resize(m_PreRotations.size());
	}

	/// From the root to the segment.
	std::vector<std::size_t> Chain(std::size_t i_Segment) const
	{
		std::vector<std::size_t> chain{i_Segment};
		while (chain.front() != 0)
			chain.insert(chain.begin(), m_rSubject.m_Segments[chain.front()].m_ParentSegmentIndex);
		return chain;
	}

	const VSubject& m_rSubject;
	std::vector<Quaterniond> m_PreRotations;
	std::vector<Vector3d> m_PreTranslations;
	std::vector<VJointState> m_States;
	std::vector<VJointState> m_Before;
	std::span<const double> m_Positions;
	std::span<const double> m_Rotations;
};

template <typename T>
Eigen::Matrix<T, 3, 1> AngleAxis(const Eigen::Quaternion<T>& i_rRotation)
{
	const T wxyz[] = {i_rRotation.w(), i_rRotation.x(), i_rRotation.y(), i_rRotation.z()};
	Eigen::Matrix<T, 3, 1> angleAxis;
	ceres::QuaternionToAngleAxis(wxyz, angleAxis.data());
	return angleAxis;
}

/// Of a target, by the rotations of its chain and the position of the root.
struct VTargetResidual
{
	VTargetResidual(const VModel& i_rModel, const VSubject::VTarget& i_rTarget)
	    : m_rModel(i_rModel), m_rTarget(i_rTarget), m_Chain(i_rModel.Chain(i_rTarget.m_SegmentIndices.front())),
	      m_Weight(std::sqrt(i_rTarget.m_Weight))
	{
		const Vector3d offset(i_rTarget.m_State.data());
		m_Offset = offset;
		m_Turn = Eigen::AngleAxisd(offset.norm(), offset.stableNormalized());
	}

	bool IsRotation() const { return m_rTarget.m_MarkerIndices.empty(); }

	/// @param i_ppParameters the root's position, then the rotations.
	template <typename T>
	bool operator()(T const* const* i_ppParameters, T* o_pResiduals) const
	{
		using VVector = Eigen::Matrix<T, 3, 1>;
		using VQuaternion = Eigen::Quaternion<T>;
		VVector position = VVector::Zero();
		VQuaternion rotation = VQuaternion::Identity();
		for (std::size_t i = 0; i < m_Chain.size(); ++i)
		{
			position += rotation * m_rModel.m_PreTranslations[m_Chain[i]].template cast<T>();
			rotation = rotation * m_rModel.m_PreRotations[m_Chain[i]].template cast<T>();
			if (i == 0)
				position += rotation * Eigen::Map<const VVector>(i_ppParameters[0]);
			rotation = rotation * Eigen::Map<const VQuaternion>(i_ppParameters[i + 1]);
		}
		Eigen::Map<VVector> residual(o_pResiduals);
		if (IsRotation())
			residual = m_Weight * ComputeSubject::c_RotationLength
			    * AngleAxis<T>(rotation * (m_Turn * Observed().conjugate()).template cast<T>());
		else
			residual = m_Weight * (position + rotation * m_Offset.template cast<T>() - Point().template cast<T>());
		return true;
	}

	Vector3d Point() const { return Vector3d(&m_rModel.m_Positions[3 * m_rTarget.m_MarkerIndices.front()]); }
	Quaterniond Observed() const
	{
		return Quaterniond(Matrix3d(
		    Eigen::Map<const VRows>(&m_rModel.m_Rotations[9 * m_rTarget.m_RotationObservationIndices.front()])));
	}

	const VModel& m_rModel;
	const VSubject::VTarget& m_rTarget;
	std::vector<std::size_t> m_Chain;
	double m_Weight;
	Vector3d m_Offset;
	Quaterniond m_Turn;
};

Matrix3d Cross(const Vector3d& v)
{
	Matrix3d m;
	m << 0, -v[2], v[1], v[2], 0, -v[0], -v[1], v[0], 0;
	return m;
}

Matrix3d InverseLeftJacobian(const Vector3d& i_rTurn)
{
	const double angle = i_rTurn.norm();
	const double factor = angle > 1e-4 ? (1.0 - 0.5 * angle / std::tan(0.5 * angle)) / (angle * angle) : 1.0 / 12.0;
	return Matrix3d::Identity() - 0.5 * Cross(i_rTurn) + factor * Cross(i_rTurn) * Cross(i_rTurn);
}

/// From the derivatives by a turn on the quaternion's left to those by its four numbers. Ceres turns by twice the
/// change.
void StoreDerivatives(const Matrix3d& i_rByTurn, const double* i_pQuaternion, double* o_pJacobian)
{
	double plus[12];
	ceres::EigenQuaternionManifold().PlusJacobian(i_pQuaternion, plus);
	Eigen::Map<Eigen::Matrix<double, 3, 4, Eigen::RowMajor>> jacobian(o_pJacobian);
	jacobian = 2.0 * i_rByTurn * Eigen::Map<Eigen::Matrix<double, 4, 3, Eigen::RowMajor>>(plus).transpose();
}

class VAnalyticTarget : public ceres::CostFunction
{
public:
	VAnalyticTarget(const VModel& i_rModel, const VSubject::VTarget& i_rTarget) : m_Residual(i_rModel, i_rTarget)
	{
		set_num_residuals(3);
		mutable_parameter_block_sizes()->push_back(3);
		mutable_parameter_block_sizes()->resize(m_Residual.m_Chain.size() + 1, 4);
		m_Bases.resize(m_Residual.m_Chain.size());
		m_Centres.resize(m_Residual.m_Chain.size());
	}

	bool Evaluate(double const* const* i_ppParameters, double* o_pResiduals, double** o_ppJacobians) const override
	{
		const auto& rChain = m_Residual.m_Chain;
		Vector3d position = Vector3d::Zero();
		Matrix3d rotation = Matrix3d::Identity();
		for (std::size_t i = 0; i < rChain.size(); ++i)
		{
			position += rotation * m_Residual.m_rModel.m_PreTranslations[rChain[i]];
			rotation = rotation * m_Residual.m_rModel.m_PreRotations[rChain[i]];
			if (i == 0)
				position += rotation * Eigen::Map<const Vector3d>(i_ppParameters[0]);
			m_Bases[i] = rotation;
			m_Centres[i] = position;
			rotation = rotation * Eigen::Map<const Quaterniond>(i_ppParameters[i + 1]);
		}
		Eigen::Map<Vector3d> residual(o_pResiduals);
		Matrix3d byTurn;
		Vector3d point = Vector3d::Zero();
		if (m_Residual.IsRotation())
		{
			const Vector3d turn =
			    AngleAxis<double>(Quaterniond(rotation) * m_Residual.m_Turn * m_Residual.Observed().conjugate());
			const double weight = m_Residual.m_Weight * ComputeSubject::c_RotationLength;
			residual = weight * turn;
			byTurn = weight * InverseLeftJacobian(turn);
		}
		else
		{
			point = position + rotation * m_Residual.m_Offset;
			residual = m_Residual.m_Weight * (point - m_Residual.Point());
		}
		if (!o_ppJacobians)
			return true;
		if (o_ppJacobians[0])
		{
			Eigen::Map<VRows> jacobian(o_ppJacobians[0]);
			jacobian = (m_Residual.IsRotation() ? 0.0 : m_Residual.m_Weight) * m_Bases[0];
		}
		for (std::size_t i = 0; i < rChain.size(); ++i)
			if (o_ppJacobians[i + 1])
			{
				if (!m_Residual.IsRotation())
					byTurn = -m_Residual.m_Weight * Cross(point - m_Centres[i]);
				StoreDerivatives(byTurn * m_Bases[i], i_ppParameters[i + 1], o_ppJacobians[i + 1]);
			}
		return true;
	}

private:
	VTargetResidual m_Residual;
	mutable std::vector<Matrix3d> m_Bases;
	mutable std::vector<Vector3d> m_Centres;
};

/// The turn from one rotation to a joint's, times the root of a weight for each axis.
struct VTurnResidual
{
	template <typename T>
	bool operator()(const T* i_pRotation, T* o_pResidual) const
	{
		const Eigen::Quaternion<T> rotation =
		    m_rFrom.conjugate().template cast<T>() * Eigen::Map<const Eigen::Quaternion<T>>(i_pRotation);
		Eigen::Map<Eigen::Matrix<T, 3, 1>> residual(o_pResidual);
		residual = m_Weight * AngleAxis<T>(rotation);
		return true;
	}

	const Quaterniond& m_rFrom;
	double m_Weight;
};

class VAnalyticTurn : public ceres::SizedCostFunction<3, 4>
{
public:
	VAnalyticTurn(const Quaterniond& i_rFrom, double i_Weight) : m_Residual{i_rFrom, i_Weight} {}

	bool Evaluate(double const* const* i_ppParameters, double* o_pResiduals, double** o_ppJacobians) const override
	{
		m_Residual(i_ppParameters[0], o_pResiduals);
		if (o_ppJacobians && o_ppJacobians[0])
			StoreDerivatives(m_Residual.m_Weight
			        * InverseLeftJacobian(Eigen::Map<const Vector3d>(o_pResiduals) / m_Residual.m_Weight)
			        * m_Residual.m_rFrom.conjugate().toRotationMatrix(),
			    i_ppParameters[0], o_ppJacobians[0]);
		return true;
	}

private:
	VTurnResidual m_Residual;
};

/// The difference of positions.
struct VMoveResidual
{
	template <typename T>
	bool operator()(const T* i_pPosition, T* o_pResidual) const
	{
		for (int i = 0; i < 3; ++i)
			o_pResidual[i] = m_Weight * (i_pPosition[i] - m_rFrom[i]);
		return true;
	}

	const Vector3d& m_rFrom;
	double m_Weight;
};

} // namespace

struct VCeresPeer::VImplementation
{
	VImplementation(const VSubject& i_rSubject, bool i_bAnalytic) : m_Subject(i_rSubject), m_Model(m_Subject)
	{
		ceres::Problem::Options options;
		options.disable_all_safety_checks = true;
		m_pProblem = std::make_unique<ceres::Problem>(options);
		double* const pRoot = m_Model.m_States[0].m_Position.data();
		m_pProblem->AddParameterBlock(pRoot, 3);
		for (VJointState& rState : m_Model.m_States)
			m_pProblem->AddParameterBlock(rState.m_Rotation.coeffs().data(), 4, new ceres::EigenQuaternionManifold);
		for (const VSubject::VTarget& rTarget : m_Subject.m_Targets)
		{
			std::vector<double*> blocks{pRoot};
			for (const std::size_t segment : m_Model.Chain(rTarget.m_SegmentIndices.front()))
				blocks.push_back(m_Model.m_States[segment].m_Rotation.coeffs().data());
			if (i_bAnalytic)
			{
				m_pProblem->AddResidualBlock(new VAnalyticTarget(m_Model, rTarget), nullptr, blocks);
				continue;
			}
			auto* const pCost =
			    new ceres::DynamicAutoDiffCostFunction<VTargetResidual, 8>(new VTargetResidual(m_Model, rTarget));
			pCost->AddParameterBlock(3);
			for (std::size_t i = 1; i < blocks.size(); ++i)
				pCost->AddParameterBlock(4);
			pCost->SetNumResiduals(3);
			m_pProblem->AddResidualBlock(pCost, nullptr, blocks);
		}
		const auto addTurn = [&](const Quaterniond& i_rFrom, double i_Weight, Quaterniond& i_rRotation)
		{
			ceres::CostFunction* pCost = nullptr;
			if (i_bAnalytic)
				pCost = new VAnalyticTurn(i_rFrom, i_Weight);
			else
				pCost = new ceres::AutoDiffCostFunction<VTurnResidual, 3, 4>(new VTurnResidual{i_rFrom, i_Weight});
			m_pProblem->AddResidualBlock(pCost, nullptr, i_rRotation.coeffs().data());
		};
		const double pull = std::sqrt(ComputeSubject::c_PullScale);
		for (std::size_t i = 0; i < m_Model.m_States.size(); ++i)
		{
			addTurn(m_Model.m_Before[i].m_Rotation, pull, m_Model.m_States[i].m_Rotation);
			if (!m_Subject.m_Segments[i].m_Joint.m_Covariance.empty())
				addTurn(m_Mean,
				    std::sqrt(ComputeSubject::c_PriorScale / m_Subject.m_Segments[i].m_Joint.m_Covariance[0]),
				    m_Model.m_States[i].m_Rotation);
		}
		m_pProblem->AddResidualBlock(new ceres::AutoDiffCostFunction<VMoveResidual, 3, 3>(new VMoveResidual{
		                                 m_Model.m_Before[0].m_Position, pull / ComputeSubject::c_RotationLength}),
		    nullptr, pRoot);
	}

	const VSubject m_Subject;
	VModel m_Model;
	const Quaterniond m_Mean = Quaterniond::Identity();
	std::unique_ptr<ceres::Problem> m_pProblem;
	int m_Iterations = 0;
};

VCeresPeer::VCeresPeer(const VSubject& i_rSubject, bool i_bAnalytic)
    : m_pImplementation(std::make_unique<VImplementation>(i_rSubject, i_bAnalytic))
{
}

VCeresPeer::~VCeresPeer() = default;

double VCeresPeer::Solve(std::span<const double> i_Positions, std::span<const double> i_Rotations,
    std::span<const double> i_Before, double i_Tolerance)
{
	VModel& rModel = m_pImplementation->m_Model;
	rModel.m_Positions = i_Positions;
	rModel.m_Rotations = i_Rotations;
	const double* pState = i_Before.data();
	for (std::size_t i = 0; i < rModel.m_States.size(); ++i)
	{
		const Vector3d turn(pState);
		rModel.m_Before[i].m_Rotation = Eigen::AngleAxisd(turn.norm(), turn.stableNormalized());
		pState += 3;
		if (i == 0)
		{
			rModel.m_Before[i].m_Position = Vector3d(pState);
			pState += 3;
		}
		rModel.m_States[i] = rModel.m_Before[i];
	}
	ceres::Solver::Options options;
	options.linear_solver_type = ceres::SPARSE_NORMAL_CHOLESKY;
	options.max_num_iterations = 500;
	options.function_tolerance = i_Tolerance;
	options.gradient_tolerance = 1e-14;
	options.parameter_tolerance = 1e-14;
	options.logging_type = ceres::SILENT;
	ceres::Solver::Summary summary;
	ceres::Solve(options, m_pImplementation->m_pProblem.get(), &summary);
	m_pImplementation->m_Iterations = summary.num_successful_steps + summary.num_unsuccessful_steps;
	return 2.0 * summary.final_cost;
}

int VCeresPeer::Iterations() const
{
	return m_pImplementation->m_Iterations;
}
