#pragma once

#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

class QOpenGLContextGroup;

namespace CoreGraphics
{

class VShader;
class VShaderProgram;

/// The shaders by name, and the programs that they are linked to by pair of names. It is made without OpenGL, by the
/// host; everything from InitialiseGL on runs on the render thread with the context current. Not thread safe.
class VShaderLibrary
{
public:
	struct VSettings
	{
		/// Shaders come from the source folders first, and Reload works.
		bool m_bDevelopment = false;
		/// Folders that hold "VertexShaders" and "FragmentShaders", and may hold "Shared".
		std::vector<std::string> m_SourceFolders;
		/// The folder that holds "Geometry"; looked for beside the binary if empty.
		std::string m_ResourceRoot;
	};

	VShaderLibrary();
	explicit VShaderLibrary(VSettings i_Settings);
	~VShaderLibrary();
	VShaderLibrary(const VShaderLibrary&) = delete;
	VShaderLibrary& operator=(const VShaderLibrary&) = delete;

	/// Loads all shaders, once. In a context that shares nothing with the one before, all shaders and programs are made
	/// again in place, so that whoever holds a program goes on with it.
	void InitialiseGL();

	/// Empty if a name is unknown. A program whose link failed is given, and is empty itself.
	std::shared_ptr<VShaderProgram> GetProgram(const std::string& i_rVertex, const std::string& i_rFragment);

	/// In development mode: compiles every shader from its file again, and links every program in place.
	void Reload();

	bool IsDevelopment() const { return m_Settings.m_bDevelopment; }

	/// The folder that holds "Geometry", in UTF-8; empty if there is none.
	const std::string& GetResourceRoot() const { return m_Settings.m_ResourceRoot; }

	std::vector<std::string> GetVertexShaderNames() const;
	std::vector<std::string> GetFragmentShaderNames() const;
	std::size_t GetProgramCount() const { return m_Programs.size(); }

private:
	using VShaders = std::map<std::string, std::shared_ptr<VShader>>;

	void LoadAll(const std::string& i_rFolder, bool i_bOnlyMissing);
	void MakeAgain();

	VShaders m_VertexShaders;
	VShaders m_FragmentShaders;
	std::map<std::pair<std::string, std::string>, std::shared_ptr<VShaderProgram>> m_Programs;
	VSettings m_Settings;
	/// The share group that everything lives in; null before InitialiseGL and after the group is gone.
	struct VGroup;
	std::unique_ptr<VGroup> m_pGroup;
};

} // namespace CoreGraphics
