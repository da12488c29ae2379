// A unit sphere at a place, with a radius.
uniform mat4 u_ViewProjection;
uniform vec4 u_ReconPosAndSize;
uniform vec4 u_ModelColour;

attribute vec3 a_position;

varying vec4 v_Colour;
varying vec3 v_Normal;

void main()
{
	v_Colour = u_ModelColour;
	v_Normal = a_position;
	gl_Position = u_ViewProjection * vec4(a_position * u_ReconPosAndSize.w + u_ReconPosAndSize.xyz, 1.0);
}
