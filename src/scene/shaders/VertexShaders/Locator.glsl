// A cross of unit length about a place, with a size.
uniform mat4 u_ViewProjection;
uniform vec4 u_ReconPosAndSize;
uniform vec4 u_ModelColour;

attribute vec3 a_position;

varying vec4 v_Colour;

void main()
{
	v_Colour = u_ModelColour;
	gl_Position = u_ViewProjection * vec4(a_position * u_ReconPosAndSize.w + u_ReconPosAndSize.xyz, 1.0);
}
