// A ray from a camera to what it sees: a_position.z goes from the one to the other.
uniform mat4 u_ViewProjection;
uniform vec3 u_RayStart;
uniform vec3 u_RayEnd;
uniform vec4 u_ModelColour;

attribute vec3 a_position;

varying vec4 v_Colour;
varying vec3 v_Position;

void main()
{
	v_Colour = u_ModelColour;
	v_Position = mix(u_RayStart, u_RayEnd, a_position.z);
	gl_Position = u_ViewProjection * vec4(v_Position, 1.0);
}
