// A unit cylinder between two markers, from the one's colour to the other's.
uniform mat4 u_ViewProjection;
uniform mat4 u_ModelTransform;
uniform vec4 u_StickColourA;
uniform vec4 u_StickColourB;

attribute vec3 a_position;

varying vec4 v_Colour;

void main()
{
	v_Colour = mix(u_StickColourA, u_StickColourB, a_position.z);
	gl_Position = u_ViewProjection * (u_ModelTransform * vec4(a_position, 1.0));
}
