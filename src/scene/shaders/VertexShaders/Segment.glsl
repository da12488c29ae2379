// A bone. Its stripe is found by the normal in the bone's own space.
uniform mat4 u_ViewProjection;
uniform mat4 u_ModelTransform;
uniform vec4 u_SegmentColour;

attribute vec3 a_position;
attribute vec3 a_normal;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_LocalNormal;

void main()
{
	v_Colour = u_SegmentColour;
	v_Normal = ToWorld(u_ModelTransform, a_normal);
	v_LocalNormal = a_normal;
	gl_Position = u_ViewProjection * (u_ModelTransform * vec4(a_position, 1.0));
}
