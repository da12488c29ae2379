// A skin on its bones: up to four a vertex.
uniform mat4 u_ViewProjection;
uniform vec3 u_CameraPosition;
// From where the skin was bound to where its bones are. Element (3, 3) is the health of the segment that moves the bone.
uniform mat4 u_BoneTransforms[250];
uniform bool u_HighlightMissing;

attribute vec3 a_position;
attribute vec3 a_normal;
attribute vec2 a_uv;
attribute vec4 a_BoneIndices;
attribute vec4 a_BoneWeights;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_Eye;
varying vec2 v_UV;

vec3 s_Position = vec3(0.0);
vec3 s_Normal = vec3(0.0);
float s_Weight = 0.0;
float s_Health = 1.0;

void AddInfluence(float i_Index, float i_Weight)
{
	if (i_Weight <= 0.0)
		return;
	// A skin may have more bones than there is room for.
	mat4 bone = u_BoneTransforms[int(min(i_Index, 249.0) + 0.5)];
	s_Health -= (1.0 - bone[3][3]) * i_Weight;
	bone[3][3] = 1.0;
	s_Position += i_Weight * (bone * vec4(a_position, 1.0)).xyz;
	s_Normal += i_Weight * (bone * vec4(a_normal, 0.0)).xyz;
	s_Weight += i_Weight;
}

void main()
{
	AddInfluence(a_BoneIndices.x, a_BoneWeights.x);
	AddInfluence(a_BoneIndices.y, a_BoneWeights.y);
	AddInfluence(a_BoneIndices.z, a_BoneWeights.z);
	AddInfluence(a_BoneIndices.w, a_BoneWeights.w);
	// What no bone moves goes with the first.
	if (s_Weight == 0.0)
		AddInfluence(0.0, 1.0);

	// The weights' fractions were cut off: their sum may be below 1.
	vec3 position = s_Position / s_Weight;
	v_Colour = u_HighlightMissing ? vec4(1.0, s_Health, s_Health, 1.0) : vec4(1.0);
	v_Normal = normalize(s_Normal);
	v_Eye = FromCamera(position, u_CameraPosition);
	v_UV = a_uv;
	gl_Position = u_ViewProjection * vec4(position, 1.0);
}
