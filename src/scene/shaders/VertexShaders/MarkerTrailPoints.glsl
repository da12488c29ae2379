// Where a marker was and will be: points of the vertices' colours, of a size in pixels.
uniform mat4 u_ViewProjection;
uniform float u_PointSize;

attribute vec3 a_position;
attribute vec4 a_colour;

varying vec4 v_Colour;

void main()
{
	v_Colour = a_colour;
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
	gl_PointSize = u_PointSize;
}
