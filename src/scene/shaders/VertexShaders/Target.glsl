// A unit cube at a place, with the length of an edge.
uniform mat4 u_ViewProjection;
uniform vec4 u_TargetPosAndSize;
uniform vec4 u_ModelColour;

attribute vec3 a_position;

varying vec4 v_Colour;

void main()
{
	v_Colour = u_ModelColour;
	gl_Position = u_ViewProjection * vec4(a_position * u_TargetPosAndSize.w + u_TargetPosAndSize.xyz, 1.0);
}
