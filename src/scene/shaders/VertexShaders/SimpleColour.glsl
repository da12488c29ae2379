// The colours of the vertices, in clip space.
attribute vec3 a_position;
attribute vec4 a_colour;

varying vec4 v_Colour;

void main()
{
	v_Colour = a_colour;
	gl_Position = vec4(a_position, 1.0);
}
