#include "../UtilsFileSystem/Log.h"
#include "MeshFile.h"
#include "Pictures.h"
#include "SmallFiles.h"
#include "SoundScene.h"

#include <gtest/gtest.h>
#include <libdeflate.h>

#include <cmath>
#include <fstream>
#include <malloc.h>

using namespace FBXIO;
using namespace FbxTest;
using namespace std::string_literals;

namespace
{

/// What is left of a hostile file.
struct VOutcome
{
	bool m_bComplete = true;
	std::size_t m_Bones = 2;
	/// Placed, and with a skin.
	std::size_t m_Meshes = 1;
	std::size_t m_Skinned = 1;
	/// Text of a message that tells of it; none if it is nothing to tell.
	std::string m_Message;
};

struct VHostileRow
{
	const char* m_pName;
	std::string (*m_Write)();
	VOutcome m_Outcome;
};

void PrintTo(const VHostileRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

/// All records of that name.
void ForEach(
    std::vector<VTestRecord>& io_rRecords, std::string_view i_Name, const std::function<void(VTestRecord&)>& i_rVisit)
{
	for (VTestRecord& rRecord : io_rRecords)
	{
		if (rRecord.m_Name == i_Name)
			i_rVisit(rRecord);
		ForEach(rRecord.m_Children, i_Name, i_rVisit);
	}
}

/// The small file in binary 7.4 with another value in all records of that name.
std::string With(std::string_view i_Name, const VTestValue& i_rValue, const VSmallFile& i_rFile = c_SmallFiles[1])
{
	std::vector<VTestRecord> records = SmallRecords(i_rFile);
	ForEach(records, i_Name, [&](VTestRecord& io_rRecord) { io_rRecord.m_Values = {i_rValue}; });
	return Write(i_rFile.m_Form, records);
}

/// An array that claims that many numbers and has the bytes that so many need at the best.
VRaw Bomb(char i_Type, std::size_t i_Count, std::size_t i_ItemSize)
{
	const std::string packed = Deflate(std::string(1 << 20, '\0'));
	const std::string bytes = packed + std::string(i_Count * i_ItemSize / 1032 + 1, '\0');
	return {Bytes(i_Type, std::uint32_t(i_Count), 1u, std::uint32_t(bytes.size()), bytes)};
}

std::string Repeated(std::size_t i_Count, const std::function<std::string(std::size_t)>& i_rText)
{
	std::string text;
	for (std::size_t i = 0; i < i_Count; ++i)
		text += i_rText(i);
	return text;
}

/// The small file as text 7.4 with more lines among its objects and its connections.
std::string WithLines(const std::string& i_rObjects, const std::string& i_rConnections)
{
	std::string text = Write(c_SmallFiles[4].m_Form, SmallRecords(c_SmallFiles[4]));
	text.insert(text.find("Connections:  {\n") + 16, i_rConnections);
	text.insert(text.find("Objects:  {\n") + 12, i_rObjects);
	return text;
}

std::string Connection(std::size_t i_Child, std::size_t i_Parent)
{
	return "C: \"OO\"," + std::to_string(i_Child) + ',' + std::to_string(i_Parent) + '\n';
}

/// As many nodes more, each with the parts of these numbers.
void AddNodes(std::vector<VTestRecord>& io_rRecords, std::int64_t i_Count, std::initializer_list<std::size_t> i_Parts)
{
	for (VTestRecord& rSection : io_rRecords)
		for (std::int64_t node = 100; node < 100 + i_Count; ++node)
			if (rSection.m_Name == "Objects")
				rSection.m_Children.push_back({"Model", {node, "Model::again"s, "Mesh"s}, {}});
			else if (rSection.m_Name == "Connections")
			{
				rSection.m_Children.push_back({"C", {"OO"s, node, std::int64_t(0)}, {}});
				for (const std::size_t part : i_Parts)
					rSection.m_Children.push_back({"C", {"OO"s, std::int64_t(part), node}, {}});
			}
}

/// A small PNG with texts that become 8 MB each.
const std::string& PackedTexts()
{
	static const std::string s_File = []
	{
		std::string text = "zTXtkey"s + '\0' + '\0' + Deflate(std::string(7'900'000, 'a'));
		const auto bigEndian = [](std::size_t i_Number)
		{
			std::string bytes;
			for (int shift = 24; shift >= 0; shift -= 8)
				bytes += char(i_Number >> shift);
			return bytes;
		};
		text = bigEndian(text.size() - 4) + text + bigEndian(libdeflate_crc32(0, text.data(), text.size()));
		// Behind the head and its chunk.
		return PngOf(8, 8).insert(33, Repeated(40, [&](std::size_t) { return text; }));
	}();
	return s_File;
}

/// Numbers of the small file's objects: nodes from 1 on, attributes, then those of the mesh in their order.
constexpr std::size_t c_Hips = 1;
constexpr std::size_t c_Knee = 2;
constexpr std::size_t c_Body = 3;
constexpr std::size_t c_Mesh = 2'000'000;
constexpr std::size_t c_FirstMaterial = c_Mesh + 1;
constexpr std::size_t c_Texture = c_Mesh + 2;
constexpr std::size_t c_Skin = c_Mesh + 4;
constexpr std::size_t c_FirstCluster = c_Mesh + 5;

const std::string c_Large = " left out because it is damaged or too large";
const std::string c_Polygons =
    "Polygons left out of mesh bodyShape because they have no end or name control points that do not exist: ";

const VHostileRow c_Rows[]{
    {"BombBeyondTheBudget", [] { return With("Vertices", Bomb('d', 40'000'000, 8)); },
        {true, 2, 0, 0, "Array Vertices of bodyShape" + c_Large}},
    {"PointsThatAreAllAlike",
        [] { return With("Vertices", PackedArray('d', 12'000'000, true, std::string(96'000'000, '\0'))); },
        {true, 2, 0, 0, "Array Vertices of bodyShape" + c_Large}},
    {"BombWithinTheBudget", [] { return With("Vertices", Bomb('d', 12'000'000, 8)); },
        {true, 2, 0, 0, "Array Vertices of bodyShape" + c_Large}},
    {"BombsTogetherBeyondTheBudget", [] { return With("Indexes", Bomb('i', 40'000'000, 4)); },
        {true, 2, 1, 1, "Array Indexes of body cluster1" + c_Large}},
    {"BombThatItsBytesCannotHold", [] { return With("Vertices", PackedArray('d', 30'000'000, true, "")); },
        {false, 2, 1, 1, "the values of a record are damaged"}},
    {"PolygonCountOf2To31",
        [] { return With("PolygonVertexIndex", PackedArray('i', 0x80000000, false, std::string(24, '\0'))); },
        {false, 2, 1, 1, "the values of a record are damaged"}},
    {"PolygonCountOf2To31AsText",
        [] { return With("PolygonVertexIndex", VRaw{"*2147483648 {\n a: 0,1,-3\n}"}, c_SmallFiles[4]); },
        {false, 2, 1, 1, "the numbers of an array are missing"}},
    {"ThreeMillionPolygons",
        [] { return With("PolygonVertexIndex", PackedArray('i', 3'000'000, true, std::string(12'000'000, '\xff'))); },
        {true, 2, 0, 0, "Mesh bodyShape left out because it has too many polygons"}},
    {"HugeAndNegativeVertices",
        [] {
	        return With("PolygonVertexIndex", VIntegers{0, 0x7fffffff, -3, 0, 1, -0x7fffffff - 1, 0, 1, -3});
        },
        {true, 2, 1, 1, c_Polygons + "2"}},
    {"PolygonWithoutEnd", [] { return With("PolygonVertexIndex", VIntegers(100'000, 1)); },
        {true, 2, 1, 1, c_Polygons + "1"}},
    {"HugeAndNegativeCoordinateIndices",
        [] {
	        return With("UVIndex", VIntegers{0, 0x7fffffff, -0x7fffffff - 1, 1, 3, -1});
        },
        {true, 2, 1, 1, "3 vertices of mesh body have no texture coordinate"}},
    {"HugeAndNegativeMaterials",
        [] {
	        return With("Materials", VIntegers{0x7fffffff, -0x7fffffff - 1});
        },
        {}},
    {"HugeAndNegativeClusterIndices",
        [] {
	        return With("Indexes", VIntegers{-1, 0x7fffffff, -0x7fffffff - 1});
        },
        {true, 2, 1, 1,
            "6 weights of mesh body left out because they are no numbers or name control points that do not exist"}},
    {"NodesInARing",
        []
        {
	        return WithLines("Model: 50,\"Model::a\",\"LimbNode\"\nModel: 51,\"Model::b\",\"LimbNode\"\n",
	            Connection(50, 51) + Connection(51, 50) + Connection(c_Mesh, 50));
        },
        {true, 2, 1, 1, "Nodes left out because their connections lead round in a ring: 2"}},
    {"NodeBelowItselfAndItsChild",
        [] { return WithLines({}, Connection(c_Hips, c_Hips) + Connection(c_Hips, c_Knee)); },
        {true, 0, 1, 0, "Nodes left out because their connections lead round in a ring: 2"}},
    {"PartsInARing",
        []
        {
	        return WithLines({},
	            Connection(c_Skin, c_FirstCluster) + Connection(c_Mesh, c_Skin) + Connection(c_FirstCluster, c_Hips)
	                + Connection(c_Body, c_Mesh) + Connection(c_Skin, c_Skin));
        },
        {}},
    {"TextRecordsAHundredThousandDeep",
        [] { return WithLines(Repeated(100'000, [](std::size_t) { return "Model: {"s; }), {}); },
        {false, 0, 0, 0, "its records lie more than 64 deep in one another"}},
    {"BinaryRecordsTwoThousandDeep",
        []
        {
	        VTestRecord record{"Deep", {}, {}};
	        for (int i = 0; i < 2000; ++i)
	        {
		        VTestRecord outer{"Deep", {}, {}};
		        outer.m_Children.push_back(std::move(record));
		        record = std::move(outer);
	        }
	        std::vector<VTestRecord> records = SmallRecords(c_SmallFiles[1]);
	        records.push_back(std::move(record));
	        return Write(c_Forms[1], records);
        },
        {false, 2, 1, 1, "its records lie more than 64 deep in one another"}},
    {"NodesFiftyFiveThousandDeep",
        []
        {
	        return WithLines(
	            Repeated(55'000,
	                [](std::size_t i) { return "Model: " + std::to_string(100 + i) + ",\"Model::a\",\"Null\"\n"; }),
	            Connection(100, 0) + Repeated(54'999, [](std::size_t i) { return Connection(101 + i, 100 + i); })
	                + Connection(c_Mesh, 55'099));
        },
        {true, 2, 2, 2, {}}},
    {"AMeshAndItsSkinInThreeHundredNodes",
        []
        {
	        std::vector<VTestRecord> records = SmallRecords(c_SmallFiles[1]);
	        ForEach(
	            records, "Vertices", [](VTestRecord& io_rRecord) { io_rRecord.m_Values = {VNumbers(90'000, 1.0)}; });
	        AddNodes(records, 300, {c_Mesh});
	        return Write(c_Forms[1], records);
        },
        {true, 2, 29, 25, "Mesh again left out because the meshes of the file are too large"}},
    {"LongNamesOfWhatManyNodesShare",
        []
        {
	        std::vector<VTestRecord> records = SmallRecords(c_SmallFiles[1]);
	        const std::string name(600'000, 'x');
	        ForEach(records, "Geometry", [&](VTestRecord& io_rRecord) { io_rRecord.m_Values[1] = name; });
	        ForEach(records, "FileName", [&](VTestRecord& io_rRecord) { io_rRecord.m_Values[0] = name; });
	        // It is told of each mesh that it has none.
	        ForEach(records, "LayerElementMaterial", [](VTestRecord& io_rRecord) { io_rRecord.m_Name = "Other"; });
	        AddNodes(records, 200, {c_Mesh, c_FirstMaterial});
	        return Write(c_Forms[1], records);
        },
        {true, 2, 201, 201, "A name or path of 600000 bytes is cut to 4096: xxx"}},
    {"PictureWithFortyPackedTexts",
        []
        {
	        std::vector<VTestRecord> records = SmallRecords(c_SmallFiles[1]);
	        constexpr std::int64_t c_Video = 77;
	        for (VTestRecord& rSection : records)
		        if (rSection.m_Name == "Objects")
			        rSection.m_Children.push_back({"Video", {c_Video, "Video::"s, "Clip"s},
			            {{"Content", {VRaw{Bytes('R', std::uint32_t(PackedTexts().size()), PackedTexts())}}, {}}}});
		        else if (rSection.m_Name == "Connections")
			        rSection.m_Children.push_back({"C", {"OO"s, c_Video, std::int64_t(c_Texture)}, {}});
	        return Write(c_Forms[1], records);
        },
        {}},
    {"DuplicateIds",
        []
        {
	        return WithLines("Geometry: 2000000,\"Geometry::other\",\"Mesh\" {\n}\nModel: "
	                         "1,\"Model::other\",\"Null\"\nModel: 3,\"Model::other\",\"LimbNode\"\n",
	            {});
        },
        {true, 2, 1, 1, "Nodes left out because no connection leads to them: 2"}},
    {"TwoHundredThousandRepeatedConnections",
        []
        {
	        return WithLines({},
	            Repeated(25'000,
	                [](std::size_t)
	                {
		                return Connection(c_Knee, c_Hips) + Connection(c_Body, 0) + Connection(c_Mesh, c_Body)
		                    + Connection(c_FirstMaterial, c_Body) + Connection(c_Skin, c_Mesh)
		                    + Connection(c_FirstCluster, c_Skin) + Connection(c_Hips, c_FirstCluster) + "C: \"OP\","
		                    + std::to_string(c_Texture) + ',' + std::to_string(c_FirstMaterial) + ",\"DiffuseColor\"\n";
	                }));
        },
        {}},
    {"NamesOfTenMegabytes",
        []
        {
	        std::vector<VTestRecord> records = SmallRecords(c_SmallFiles[1]);
	        const std::string name(10'000'000, 'x');
	        ForEach(records, "Model", [&](VTestRecord& io_rRecord) { io_rRecord.m_Values[1] = name; });
	        ForEach(records, "RelativeFilename", [&](VTestRecord& io_rRecord) { io_rRecord.m_Values[0] = name; });
	        return Write(c_Forms[1], records);
        },
        {true, 2, 1, 1, {}}},
    {"TransformsThatAreNoNumbers", [] { return With("TransformLink", VNumbers(16, NAN)); },
        {true, 2, 1, 1, "Invalid transform for: hips; setting to identity"}},
    {"UnitThatIsNoNumber",
        []
        {
	        std::vector<VTestRecord> records = SmallRecords(c_SmallFiles[1]);
	        ForEach(records, "GlobalSettings",
	            [](VTestRecord& io_rRecord)
	            {
		            io_rRecord.m_Children[0].m_Children.push_back(
		                {"P", {"UnitScaleFactor"s, "double"s, "Number"s, ""s, double(NAN)}, {}});
	            });
	        return Write(c_Forms[1], records);
        },
        {true, 2, 1, 1, "Unit of nan centimetres is none; taking centimetres"}},
    {"PointsOfWordsThatAreNoNumbers",
        [] { return With("Vertices", VRaw{"*12 {\n a: 0,0,nan(ind),1,-nan,0,0,1,inf,0,1,-inf\n}"}, c_SmallFiles[4]); },
        {true, 2, 1, 1, "4 control points of mesh body have coordinates or normals that are no numbers"}},
    {"ObjectsWithoutANumber", [] { return WithLines("Model: {\n}\nDeformer: 1.5\n", {}); },
        {true, 2, 1, 1, "Objects left out because they have neither number nor name: 2"}},
};

/// From the start of the program on, what is freed goes back at once: else it would be in use before, and again.
[[maybe_unused]] const bool c_bFreesAtOnce =
    mallopt(M_MMAP_THRESHOLD, 65536) == 1 && mallopt(M_TRIM_THRESHOLD, 65536) == 1;

/// The most memory that the process has had since this was made, above what it had then.
class VPeakMemory
{
public:
	VPeakMemory()
	{
		malloc_trim(0);
		// Makes the high-water mark what is in use now.
		std::ofstream("/proc/self/clear_refs") << '5';
		m_Before = Mark();
	}

	double Megabytes() const { return (Mark() - m_Before) * 1024.0 / 1e6; }

	/// In KiB; 0 if the system does not tell.
	static double Mark()
	{
		std::ifstream status("/proc/self/status");
		for (std::string word; status >> word;)
			if (double mark = 0.0; word == "VmHWM:" && status >> mark)
				return mark;
		return 0.0;
	}

private:
	double m_Before = 0.0;
};

class HostileFile : public testing::TestWithParam<VHostileRow>
{
};

TEST_P(HostileFile, LeavesWhatIsWhole)
{
	const VOutcome& rOutcome = GetParam().m_Outcome;
	const std::string bytes = GetParam().m_Write();
	VTestLog log("FBXIO");
	const VPeakMemory memory;
	OnSmallStack(
	    [&]
	    {
		    FBXReader reader;
		    ASSERT_TRUE(reader.LoadMemory(bytes, "memory.fbx"));
		    EXPECT_EQ(reader.IsComplete(), rOutcome.m_bComplete);
		    EXPECT_EQ(reader.HasSkeleton() ? reader.GetSkeleton()->size() : 0, rOutcome.m_Bones);
		    std::vector<VPlacedMesh> placed;
		    VSkin skin;
		    EXPECT_EQ(WhatIsUnsound(reader, placed, skin), "");
		    EXPECT_EQ(placed.size(), rOutcome.m_Meshes);
		    EXPECT_EQ(skin.m_Meshes.size(), rOutcome.m_Skinned);
	    });
	EXPECT_GT(VPeakMemory::Mark(), 0.0);
#ifndef RETARGET_SANITIZED
	// With its meshes placed, and once more with their skin. The sanitizers keep for a while what is freed.
	EXPECT_LT(memory.Megabytes(), 128.0);
#endif
	const std::vector<std::string> messages = log.Take();
	const auto told = [&](const std::string& i_rText) { return i_rText.find(rOutcome.m_Message) != std::string::npos; };
	EXPECT_TRUE(std::any_of(messages.begin(), messages.end(), told)) << rOutcome.m_Message;
	// One for each node at most.
	EXPECT_LT(messages.size(), 300u) << messages.back().substr(0, 200);
}

INSTANTIATE_TEST_SUITE_P(Rows, HostileFile, testing::ValuesIn(c_Rows),
    [](const auto& i_rInfo) { return std::string(i_rInfo.param.m_pName); });

} // namespace
