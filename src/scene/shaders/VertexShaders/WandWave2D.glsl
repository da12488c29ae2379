// The trail of a wand in a camera's picture, in pixels of the sensor; uv.x is the age of each point.
uniform vec4 u_View2D;

attribute vec2 a_position;
attribute vec2 a_uv;

varying float v_Age;

void main()
{
	v_Age = a_uv.x;
	gl_Position = vec4(a_position * u_View2D.xy + u_View2D.zw, 0.0, 1.0);
}
