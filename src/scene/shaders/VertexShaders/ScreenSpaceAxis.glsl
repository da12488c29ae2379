// Axes in a corner of the screen: the view's rotation alone, as far away as they are long.

// An axis as part of half the viewport, which leaves room at its edges.
const float c_Length = 0.8;

uniform mat4 u_View;

attribute vec3 a_position;
attribute vec4 a_colour;

varying vec4 v_Colour;

void main()
{
	v_Colour = a_colour;
	vec3 position = c_Length * (u_View * vec4(a_position, 0.0)).xyz;
	// Z points at the eye in view space, and away from it on the screen.
	gl_Position = vec4(position.xy, -position.z, 1.0);
}
