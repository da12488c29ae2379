#include "SmallFiles.h"

#include "MeshFile.h"

#include <pthread.h>

#include <cmath>
#include <cstring>
#include <limits>

using namespace FbxTest;

namespace
{

using VList = std::vector<VTestRecord>;

std::size_t Below(std::mt19937& io_rRandom, std::size_t i_End)
{
	return i_End == 0 ? 0 : io_rRandom() % i_End;
}

template <typename TRange>
auto& OneOf(TRange&& i_rRange, std::mt19937& io_rRandom)
{
	return *(std::begin(i_rRange) + Below(io_rRandom, std::size(i_rRange)));
}

/// Where a record stands.
struct VPlace
{
	VList* m_pList;
	std::size_t m_Index;
	VTestRecord& Record() const { return (*m_pList)[m_Index]; }
};

std::vector<VPlace> Places(VList& i_rRecords)
{
	std::vector<VPlace> places;
	const auto add = [&places](VList& i_rList)
	{
		for (std::size_t i = 0; i < i_rList.size(); ++i)
			places.push_back({&i_rList, i});
	};
	add(i_rRecords);
	for (std::size_t i = 0; i < places.size(); ++i)
		add(places[i].Record().m_Children);
	return places;
}

VList& Section(VList& i_rRecords, const char* i_pName)
{
	static VList s_None;
	for (VTestRecord& rRecord : i_rRecords)
		if (rRecord.m_Name == i_pName)
			return rRecord.m_Children;
	s_None.clear();
	return s_None;
}

/// The first value of each object: its number, or its name.
VTestValue AnyKey(VList& i_rRecords, std::mt19937& io_rRandom)
{
	static constexpr std::int64_t c_Odd[]{0, -1, 99, std::numeric_limits<std::int64_t>::min()};
	const VList& rObjects = Section(i_rRecords, "Objects");
	if (rObjects.empty() || io_rRandom() % 5 == 0)
		return OneOf(c_Odd, io_rRandom);
	const VTestRecord& rObject = OneOf(rObjects, io_rRandom);
	return rObject.m_Values.empty() ? VTestValue(std::int64_t(0)) : rObject.m_Values.front();
}

void Lie(VList& io_rRecords, std::mt19937& io_rRandom)
{
	static constexpr std::int64_t c_By[]{1, -1, 13, -13, 25, 0x7fffffff, -0x7fffffff, std::int64_t(1) << 40};
	OneOf(OneOf(Places(io_rRecords), io_rRandom).Record().m_Lies, io_rRandom) = std::uint64_t(OneOf(c_By, io_rRandom));
}

void ChangeId(VList& io_rRecords, std::mt19937& io_rRandom)
{
	VList& rObjects = Section(io_rRecords, "Objects");
	if (rObjects.empty())
		return;
	const VTestValue key = AnyKey(io_rRecords, io_rRandom);
	if (VTestRecord& rObject = OneOf(rObjects, io_rRandom); !rObject.m_Values.empty())
		rObject.m_Values.front() = key;
}

void ChangeConnection(VList& io_rRecords, std::mt19937& io_rRandom)
{
	VList& rConnections = Section(io_rRecords, "Connections");
	if (rConnections.empty())
		return;
	const std::size_t at = Below(io_rRandom, rConnections.size());
	VTestRecord& rConnection = rConnections[at];
	if (rConnection.m_Values.size() < 3)
		return;
	switch (io_rRandom() % 6)
	{
	case 0: rConnection.m_Values[1] = AnyKey(io_rRecords, io_rRandom); break;
	case 1: rConnection.m_Values[2] = AnyKey(io_rRecords, io_rRandom); break;
	case 2: std::swap(rConnection.m_Values[1], rConnection.m_Values[2]); break;
	case 3: rConnections.erase(rConnections.begin() + std::ptrdiff_t(at)); break;
	case 4: rConnections.insert(rConnections.end(), 1 + Below(io_rRandom, 200), VTestRecord(rConnection)); break;
	case 5:
		rConnection.m_Values[0] = std::string("OP");
		rConnection.m_Values.push_back(std::string(io_rRandom() % 2 ? "DiffuseColor" : "Lcl Rotation"));
		break;
	}
}

/// Calls i_Change(values, place of an array in them) for one of the arrays.
template <typename TChange>
void ChangeArray(VList& io_rRecords, std::mt19937& io_rRandom, TChange&& i_Change)
{
	std::vector<VTestValue*> arrays;
	for (const VPlace& rPlace : Places(io_rRecords))
		for (VTestValue& rValue : rPlace.Record().m_Values)
			if (std::holds_alternative<VNumbers>(rValue) || std::holds_alternative<VIntegers>(rValue))
				arrays.push_back(&rValue);
	if (!arrays.empty())
		i_Change(*OneOf(arrays, io_rRandom));
}

VNumbers NumbersOf(const VTestValue& i_rValue)
{
	if (const auto* const pIntegers = std::get_if<VIntegers>(&i_rValue))
		return VNumbers(pIntegers->begin(), pIntegers->end());
	return std::get<VNumbers>(i_rValue);
}

void ChangeCount(VList& io_rRecords, std::mt19937& io_rRandom)
{
	ChangeArray(io_rRecords, io_rRandom,
	    [&](VTestValue& io_rValue)
	    {
		    const auto resize = [&](auto& io_rNumbers)
		    {
			    const std::size_t sizes[]{0, 1, io_rNumbers.size() - 1, io_rNumbers.size() + 1, 2 * io_rNumbers.size(),
			        Below(io_rRandom, 500)};
			    io_rNumbers.resize(OneOf(sizes, io_rRandom) % 100'000);
		    };
		    if (auto* const pIntegers = std::get_if<VIntegers>(&io_rValue))
			    resize(*pIntegers);
		    else
			    resize(std::get<VNumbers>(io_rValue));
	    });
}

void ChangeNumbers(VList& io_rRecords, std::mt19937& io_rRandom)
{
	ChangeArray(io_rRecords, io_rRandom,
	    [&](VTestValue& io_rValue)
	    {
		    for (std::size_t i = 1 + Below(io_rRandom, 4); i > 0; --i)
			    if (auto* const pIntegers = std::get_if<VIntegers>(&io_rValue); pIntegers && !pIntegers->empty())
			    {
				    const std::int32_t odd[]{0, -1, -2, 3, 4, 255, 256, 0x7fffffff, std::numeric_limits<int>::min()};
				    OneOf(*pIntegers, io_rRandom) = OneOf(odd, io_rRandom);
			    }
			    else if (auto* const pReals = std::get_if<VNumbers>(&io_rValue); pReals && !pReals->empty())
			    {
				    const double odd[]{0, -1, 0.5, 1e-310, 3e38, 1e300, INFINITY, -INFINITY, NAN};
				    OneOf(*pReals, io_rRandom) = OneOf(odd, io_rRandom);
			    }
	    });
}

template <typename T>
std::string As(const VNumbers& i_rNumbers)
{
	std::string bytes;
	for (const double number : i_rNumbers)
		AppendBytes(bytes, std::abs(number) < 100 ? T(number) : T());
	return bytes;
}

void Repack(VList& io_rRecords, std::mt19937& io_rRandom)
{
	ChangeArray(io_rRecords, io_rRandom,
	    [&](VTestValue& io_rValue)
	    {
		    const VNumbers numbers = NumbersOf(io_rValue);
		    static constexpr char c_Types[]{'f', 'd', 'i', 'l', 'b', 'c', 'z'};
		    const char kind = OneOf(c_Types, io_rRandom);
		    const std::string bytes = kind == 'f' ? As<float>(numbers)
		        : kind == 'd'                     ? As<double>(numbers)
		        : kind == 'i'                     ? As<std::int32_t>(numbers)
		        : kind == 'l'                     ? As<std::int64_t>(numbers)
		        : kind == 'z'                     ? std::string(200'000, '\0')
		                                          : As<std::int8_t>(numbers);
		    const char type = kind == 'z' ? 'd' : kind;
		    const std::size_t counts[]{
		        numbers.size(), numbers.size(), numbers.size(), bytes.size() / 8, 0x7fffffff, 0x80000000, 0xffffffff};
		    VRaw raw = PackedArray(type, OneOf(counts, io_rRandom), io_rRandom() % 3 != 0, bytes);
		    if (io_rRandom() % 4 == 0 && raw.m_Bytes.size() > 13)
			    raw.m_Bytes.at(13 + Below(io_rRandom, raw.m_Bytes.size() - 13)) ^= char(1 << io_rRandom() % 8);
		    io_rValue = std::move(raw);
	    });
}

void ChangeNesting(VList& io_rRecords, std::mt19937& io_rRandom)
{
	const std::vector<VPlace> places = Places(io_rRecords);
	if (places.empty())
		return;
	const VPlace from = OneOf(places, io_rRandom);
	const VTestRecord record = from.Record();
	switch (io_rRandom() % 4)
	{
	case 0: from.m_pList->erase(from.m_pList->begin() + std::ptrdiff_t(from.m_Index)); break;
	case 1: from.m_pList->push_back(record); break;
	case 2: OneOf(places, io_rRandom).Record().m_Children.push_back(record); break;
	case 3:
		for (std::size_t depth = 1 + Below(io_rRandom, 90); depth > 0; --depth)
		{
			VTestRecord outer{record.m_Name, {}, {}};
			outer.m_Children.push_back(std::move(from.Record()));
			from.Record() = std::move(outer);
		}
		break;
	}
}

void ChangeName(VList& io_rRecords, std::mt19937& io_rRandom)
{
	const std::vector<VPlace> places = Places(io_rRecords);
	if (!places.empty())
		OneOf(places, io_rRandom).Record().m_Name = OneOf(places, io_rRandom).Record().m_Name;
}

void ChangeValue(VList& io_rRecords, std::mt19937& io_rRandom)
{
	std::vector<VTestValue> values{std::string(), std::string(3000, 'x'), std::string("\xff\0\1", 3), std::int64_t(7),
	    std::int32_t(-1), double(NAN), double(INFINITY), VNumbers{1, 2, 3}, VIntegers{}};
	std::vector<std::vector<VTestValue>*> lists;
	for (const VPlace& rPlace : Places(io_rRecords))
	{
		std::vector<VTestValue>& rValues = rPlace.Record().m_Values;
		values.insert(values.end(), rValues.begin(), rValues.end());
		lists.push_back(&rValues);
	}
	if (lists.empty())
		return;
	std::vector<VTestValue>& rValues = *OneOf(lists, io_rRandom);
	const VTestValue value = OneOf(values, io_rRandom);
	if (rValues.empty() || io_rRandom() % 4 == 0)
		rValues.push_back(value);
	else if (io_rRandom() % 4 == 0)
		rValues.pop_back();
	else
		OneOf(rValues, io_rRandom) = value;
}

} // namespace

/// As version 5 has the same content.
static VList OldRecords(const VNumbers& i_rMatrix)
{
	const auto transform = [](double i_Y)
	{
		const auto axis = [](const char* i_pName, double i_Default)
		{ return Record("Channel", {i_pName}, {Record("Default", {i_Default})}); };
		return Record("Channel", {"Transform"}, {Record("Channel", {"T"}, {axis("X", 0), axis("Y", i_Y)})});
	};
	const auto link = [&](const char* i_pBone, VIntegers i_Points, VNumbers i_Weights)
	{
		return Record("Link", {i_pBone},
		    {Record("Indexes", {std::move(i_Points)}), Record("Weights", {std::move(i_Weights)}),
		        Record("Transform", {i_rMatrix}), Record("TransformLink", {i_rMatrix})});
	};
	const auto take = [&](const char* i_pName, double i_Y)
	{
		return Record("Take", {i_pName},
		    {Record("Model", {"hips"}, {transform(9)}), Record("Model", {"knee"}, {transform(i_Y)})});
	};
	return {Record("FBXHeaderExtension", {}, {Record("FBXVersion", {5800})}),
	    Record("Model", {"body"},
	        {Record("Material", {"first"}, {Record("Diffuse", {1.0, 0.5, 0.0})}),
	            Record("Material", {"second"}, {Record("ShadingModel", {"lambert"}), Record("Alpha", {0.75})}),
	            Record("Texture", {"picture"}, {Record("RelativeFilename", {"none.png"})}),
	            Record("Vertices", {VNumbers{0, 0, 0, 1, 0, 0, 0, 1, 0, 1, 1, 0}}),
	            Record("Normals", {VNumbers{0, 0, 1, 0, 0, 1, 0, 0, 1, 0, 0, 1}}),
	            Record("MaterialAssignation", {"ByPolygon"}), Record("Materials", {VIntegers{0, 1}}),
	            Record("PolygonVertexIndex", {VIntegers{0, 1, -3, 1, 3, -3}}),
	            Record("GeometryUVInfo", {},
	                {Record("MappingInformationType", {"ByPolygon"}),
	                    Record("TextureUV", {VNumbers{0, 0, 1, 0, 0, 1, 1, 1}}),
	                    Record("TextureUVVerticeIndex", {VIntegers{0, 1, 2, 1, 3, 2}})}),
	            link("hips", {0, 1, 2}, {1, 0.5, 0.25}), link("knee", {1, 2, 3}, {0.5, 0.75, 1})}),
	    Record("Model", {"knee"}, {Record("Type", {"LimbNode"})}),
	    Record("Model", {"hips"},
	        {Record("TypeFlags", {"Skeleton"}), transform(0), Record("Children", {"knee", "nobody"})}),
	    Record("Takes", {}, {Record("Current", {"second"}), take("first", 7), take("second", 5)})};
}

std::vector<VTestRecord> FbxTest::SmallRecords(const VSmallFile& i_rFile, const std::string& i_rPicture)
{
	const VTestScene scene{{{"hips", "LimbNode", -1, {}}, {"knee", "LimbNode", 0, {{"Lcl Translation", {0, 5, 0}}}},
	                           {"body", "Mesh", -1, {}}},
	    {{"UpAxis", {2}}}, {}, {}};
	const VNumbers matrix{1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 5, 0, 1};
	if (i_rFile.m_Form.m_Version < 6000)
		return OldRecords(matrix);
	std::vector<VTestRecord> records = Records(i_rFile.m_Form, scene,
	    {{2, {0, 0, 0, 1, 0, 0, 0, 1, 0, 1, 1, 0}, {0, 1, -3, 1, 3, -3},
	        {"ByVertice", "Direct", {0, 0, 1, 0, 0, 1, 0, 0, 1, 0, 0, 1}, {}},
	        {"ByPolygonVertex", "IndexToDirect", {0, 0, 1, 0, 0, 1, 1, 1}, {0, 1, 2, 1, 3, 2}},
	        {"ByPolygon", "IndexToDirect", {}, {0, 1}},
	        {{"phong", {{"DiffuseColor", {1, 0.5, 0}}}, "", "none.png", i_rPicture},
	            {"lambert", {{"TransparentColor", {0.25, 0.25, 0.25}}, {"TransparencyFactor", {1}}}, "", ""}},
	        {{0, {0, 1, 2}, {1, 0.5, 0.25}, matrix, matrix}, {1, {1, 2, 3}, {0.5, 0.75, 1}, matrix, matrix}}}});
	if (!i_rFile.m_bPlain)
		return records;
	for (const VPlace& rPlace : Places(records))
		for (VTestValue& rValue : rPlace.Record().m_Values)
		{
			if (std::holds_alternative<VIntegers>(rValue))
				rValue = PackedArray('i', NumbersOf(rValue).size(), false, As<std::int32_t>(NumbersOf(rValue)));
			else if (std::holds_alternative<VNumbers>(rValue))
				rValue = PackedArray('f', NumbersOf(rValue).size(), false, As<float>(NumbersOf(rValue)));
		}
	return records;
}

std::string FbxTest::MutateBytes(std::string i_Bytes, std::mt19937& io_rRandom)
{
	static const std::string c_Words[]{std::string(4, '\0'), "\xff\xff\xff\xff", "\xff\xff\xff\x7f",
	    std::string("\0\0\0\x80", 4), std::string("\0\0\xc0\x7f", 4), "{", "}", "\"", "*", ","};
	for (std::size_t changes = 1 + Below(io_rRandom, 5); changes > 0 && !i_Bytes.empty(); --changes)
	{
		const std::size_t at = Below(io_rRandom, i_Bytes.size());
		const std::size_t size = std::min<std::size_t>(1 + Below(io_rRandom, 40), i_Bytes.size() - at);
		switch (io_rRandom() % 7)
		{
		case 0: i_Bytes[at] ^= char(1 << io_rRandom() % 8); break;
		case 1: i_Bytes[at] = char(io_rRandom()); break;
		case 2: i_Bytes.erase(at, size); break;
		case 3: i_Bytes.insert(at, i_Bytes.substr(at, size)); break;
		case 4: i_Bytes.replace(Below(io_rRandom, i_Bytes.size()), size, i_Bytes.substr(at, size)); break;
		case 5:
		{
			const std::string& rWord = OneOf(c_Words, io_rRandom);
			i_Bytes.replace(at, rWord.size(), rWord);
			break;
		}
		case 6:
			if (io_rRandom() % 8 == 0)
				i_Bytes.resize(at);
			break;
		}
	}
	return i_Bytes;
}

std::vector<VTestRecord> FbxTest::MutateRecords(std::vector<VTestRecord> i_Records, std::mt19937& io_rRandom)
{
	static constexpr void (*c_Changes[])(VList&, std::mt19937&){Lie, ChangeId, ChangeConnection, ChangeConnection,
	    ChangeCount, ChangeNumbers, Repack, ChangeNesting, ChangeName, ChangeValue};
	for (std::size_t changes = 1 + Below(io_rRandom, 4); changes > 0; --changes)
		OneOf(c_Changes, io_rRandom)(i_Records, io_rRandom);
	return i_Records;
}

void FbxTest::OnSmallStack(const std::function<void()>& i_rRun)
{
	pthread_attr_t attributes;
	pthread_attr_init(&attributes);
	pthread_attr_setstacksize(&attributes, 512 * 1024);
	pthread_t thread{};
	const auto run = [](void* i_pRun) -> void*
	{
		(*static_cast<const std::function<void()>*>(i_pRun))();
		return nullptr;
	};
	if (pthread_create(&thread, &attributes, run, const_cast<std::function<void()>*>(&i_rRun)) == 0)
		pthread_join(thread, nullptr);
	else
		std::abort();
	pthread_attr_destroy(&attributes);
}
