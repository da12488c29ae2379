// The colours of the vertices, in world space.
uniform mat4 u_ViewProjection;

attribute vec3 a_position;
attribute vec4 a_colour;

varying vec4 v_Colour;

void main()
{
	v_Colour = a_colour;
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
}
